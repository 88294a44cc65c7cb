#include "app/views/FilterField.h"

#include <gtest/gtest.h>

#include <QLabel>
#include <QLineEdit>
#include <QTest>

#include "app/models/FilteredSongs.h"
#include "app/views/FilterNotes.h"
#include "tests/PrintQt.h"
#include "tests/app/Songs.h"

using namespace Qt::StringLiterals;

namespace {

class FilterFieldTest : public testing::Test {
 protected:
    FilterFieldTest() {
        for (int i = 0; i < 1200; ++i)
            AddSong(database_, u"Lied %1"_s.arg(1000 + i));
        songs_.SyncViews();
        field_.OnLeave = [this] { ++left_; };
        field_.show();
        QApplication::processEvents();
    }

    void Type(const QString& text) { QTest::keyClicks(Edit(), text); }
    QLineEdit* Edit() { return field_.findChild<QLineEdit*>(); }
    QString Count() { return field_.findChild<QLabel*>(u"filterCount"_s)->text(); }

    TMusicDatabase database_;
    SongListModel songs_{database_};
    FilteredSongs shown_{songs_};
    FilterField field_{shown_};
    int left_ = 0;
};

TEST_F(FilterFieldTest, NarrowsWithEachKeyAndCounts) {
    EXPECT_EQ(Count(), u"1.200 Songs"_s);
    Type(u"11"_s);
    EXPECT_EQ(Count(), u"120 von 1.200 Songs"_s);
    Type(u"9"_s);
    EXPECT_EQ(shown_.rowCount(), 12);
    EXPECT_EQ(Count(), u"12 von 1.200 Songs"_s);
    QTest::keyClick(Edit(), Qt::Key_Backspace);
    EXPECT_EQ(shown_.rowCount(), 120);
    EXPECT_EQ(left_, 0);
}

TEST_F(FilterFieldTest, TheCountFollowsSongsThatTheFilterHides) {
    Type(u"1199"_s);
    AddSong(database_, u"Anderes"_s);
    songs_.SyncViews();
    EXPECT_EQ(Count(), u"1 von 1.201 Songs"_s);
    database_.Clear();
    EXPECT_EQ(Count(), u"0 Songs"_s);
}

TEST_F(FilterFieldTest, TheKeysThatLeaveKeepTheFilterButEscapeKeepsOnlyItsText) {
    EXPECT_EQ(field_.SearchText(), QString());
    Type(u"119"_s);
    QTest::keyClick(Edit(), Qt::Key_Down);
    QTest::keyClick(Edit(), Qt::Key_Return);
    EXPECT_EQ(shown_.rowCount(), 12);
    QTest::keyClick(Edit(), Qt::Key_Escape);
    EXPECT_EQ(left_, 3);
    EXPECT_EQ(Edit()->text(), QString());
    EXPECT_EQ(shown_.rowCount(), 1200);
    EXPECT_EQ(field_.SearchText(), u"119"_s);
}

TEST_F(FilterFieldTest, AFieldThatThereIsNotIsTold) {
    const auto* warning = field_.findChild<QLabel*>(u"filterWarning"_s);
    for (const QString& text : {u"-foo:bar"_s, u"-artist:bar"_s, u"-c:/x"_s, u"-3:30"_s}) {
        Edit()->setText(text);
        EXPECT_EQ(warning->isVisible(), text.contains(u"foo"_s)) << text.toStdString();
    }
    Edit()->setText(u"foo:bar"_s);  // an empty list says it itself
    EXPECT_FALSE(warning->isVisible());
    EXPECT_TRUE(NothingShownText(shown_).contains(u"Kein Feld „foo“"_s));
    EXPECT_EQ(shown_.headerData(0, Qt::Horizontal).toString(), u"Titel"_s);
}

TEST_F(FilterFieldTest, InALargeCollectionReturnDoesNotWaitForThePause) {
    database_.BeginLoading();
    for (int i = 0; i < 50'000; ++i)
        database_.AddEntry(QString(), CdSong(u"Viele %1"_s.arg(i)), AddAs::Loaded);
    database_.EndLoading();
    database_.Events().Replaced.Tell();
    Type(u"lied"_s);
    EXPECT_EQ(shown_.rowCount(), 51'200);
    QTest::keyClick(Edit(), Qt::Key_Return);
    EXPECT_EQ(shown_.rowCount(), 1200);
}

}  // namespace
