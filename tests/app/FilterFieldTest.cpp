#include "app/views/FilterField.h"

#include <gtest/gtest.h>

#include <QLabel>
#include <QLineEdit>
#include <QTest>

#include "app/models/FilteredSongs.h"
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

TEST_F(FilterFieldTest, EscapeShowsAllSongsAndLeavesButTheTextCanBeSearchedOn) {
    EXPECT_EQ(field_.SearchText(), QString());
    Type(u"119"_s);
    EXPECT_EQ(field_.SearchText(), u"119"_s);
    QTest::keyClick(Edit(), Qt::Key_Escape);
    EXPECT_EQ(left_, 1);
    EXPECT_EQ(Edit()->text(), QString());
    EXPECT_EQ(shown_.rowCount(), 1200);
    EXPECT_EQ(field_.SearchText(), u"119"_s);
}

TEST_F(FilterFieldTest, DownAndReturnLeaveWithTheFilter) {
    Type(u"119"_s);
    QTest::keyClick(Edit(), Qt::Key_Down);
    QTest::keyClick(Edit(), Qt::Key_Return);
    EXPECT_EQ(left_, 2);
    EXPECT_EQ(shown_.rowCount(), 12);
}

TEST_F(FilterFieldTest, ActivatingSelectsTheTextToTypeOver) {
    Type(u"119"_s);
    field_.Activate();
    Type(u"1200"_s);
    EXPECT_EQ(Edit()->text(), u"1200"_s);
}

TEST_F(FilterFieldTest, TellsTheFields) {
    for (const QString& field : SongFilter::FieldNames())
        EXPECT_TRUE(Edit()->toolTip().contains(field)) << field.toStdString();
    EXPECT_EQ(Edit()->accessibleName(), u"Filter"_s);
}

TEST_F(FilterFieldTest, InALargeCollectionReturnDoesNotWaitForThePause) {
    database_.BeginLoading();
    for (int i = 0; i < 50'000; ++i)
        database_.AddEntry(QString(), CdSong(u"Viele %1"_s.arg(i)), AddAs::Loaded);
    database_.EndLoading();
    database_.SetSortType(stTitle);
    songs_.SyncViews();
    Type(u"lied"_s);
    EXPECT_EQ(shown_.rowCount(), 51'200);
    QTest::keyClick(Edit(), Qt::Key_Return);
    EXPECT_EQ(shown_.rowCount(), 1200);
}

}  // namespace
