#include "app/views/TagForm.h"

#include <gtest/gtest.h>

#include <QCheckBox>
#include <QLabel>
#include <QLineEdit>
#include <QMainWindow>
#include <QPushButton>
#include <QTest>

#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"
#include "tests/app/LabelFit.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kApply = 0;
constexpr int kDiscard = 1;

class TagFormTest : public testing::Test {
 protected:
    TagFormTest() {
        database_.SetModernTags(true);
        database_.SetRenameAndMoveMP3s(false);
        database_.SetSortType(stTitle);
        for (const QString& name : {u"Band - Eins.wav"_s, u"Band - Zwei.wav"_s})
            database_.AddSong(folder_.Add(name, 2));
        window_.setCentralWidget(new QWidget);
        window_.addDockWidget(Qt::RightDockWidgetArea, &form_);
        window_.resize(1024, 700);
        window_.show();
        EXPECT_TRUE(QTest::qWaitForWindowActive(&window_));
        form_.Edit();
        Choose({0, 1});
    }

    SongHandle Handle(SongIndex song) const { return database_.Songs().HandleOf(song); }
    void Choose(const std::vector<SongIndex>& songs) {
        std::vector<SongHandle> handles;
        for (const SongIndex song : songs)
            handles.push_back(Handle(song));
        form_.ShowSongs(handles, TID3TagForm::ChosenBy::Program);
    }
    template <typename T>
    T& Child(const char* name) {
        T* child = form_.findChild<T*>(QString::fromLatin1(name));
        EXPECT_NE(child, nullptr) << name;
        return *child;
    }
    void Type(const char* field, const QString& text) {
        auto& line = Child<QLineEdit>(field);
        line.setFocus();
        line.selectAll();
        QTest::keyClicks(&line, text);
    }
    QString TitleInFile(SongIndex song) const {
        return ReadSong(database_.Song(song).FileName, database_.AudioReadOptions()).Tag.Title;
    }

    SongFolder folder_;
    ScriptedDialogs dialogs_;
    TMusicDatabase database_;
    QMainWindow window_;
    TID3TagForm form_{database_};
};

TEST_F(TagFormTest, WhatWasTypedIsAppliedToAllByKey) {
    EXPECT_EQ(Child<QLineEdit>("title").placeholderText(), u"(verschieden)"_s);
    EXPECT_EQ(Child<QLineEdit>("artist").text(), u"Band"_s);
    EXPECT_FALSE(Child<QPushButton>("applyTag").isEnabled());
    Type("album", u"Sommer"_s);
    Child<QCheckBox>("flag1").click();
    EXPECT_TRUE(form_.windowTitle().endsWith(u'*'));
    QTest::keyClick(&Child<QLineEdit>("album"), Qt::Key_Return, Qt::ControlModifier);
    for (SongIndex i = 0; i < 2; ++i) {
        EXPECT_EQ(database_.Song(i).Album, u"Sommer"_s);
        EXPECT_EQ(database_.Song(i).Flags, quint32{sfBurned});
    }
    EXPECT_EQ(TitleInFile(0), u"Eins"_s);
    ASSERT_EQ(dialogs_.Reports.size(), 1U);
    EXPECT_FALSE(dialogs_.Reports[0].HasComplaints());
    EXPECT_FALSE(form_.windowTitle().endsWith(u'*'));
    EXPECT_EQ(Child<QLineEdit>("album").text(), u"Sommer"_s);
}

TEST_F(TagFormTest, EscapeTakesOneFieldBack) {
    Type("artist", u"Andere"_s);
    Type("title", u"x"_s);
    QTest::keyClick(&Child<QLineEdit>("title"), Qt::Key_Escape);
    EXPECT_EQ(Child<QLineEdit>("title").text(), QString());
    EXPECT_EQ(Child<QLineEdit>("artist").text(), u"Andere"_s);
    EXPECT_TRUE(form_.windowTitle().endsWith(u'*'));
}

TEST_F(TagFormTest, EditsOutliveAnotherChoiceAndAreOnlyLostWhenTheUserSaysSo) {
    Type("title", u"Neu"_s);
    Choose({0});
    Choose({});
    EXPECT_EQ(Child<QLineEdit>("title").text(), u"Neu"_s);
    EXPECT_FALSE(form_.close());
    EXPECT_TRUE(form_.isVisible());
    ASSERT_EQ(dialogs_.Asked.size(), 1U);
    EXPECT_EQ(dialogs_.Asked[0].DefaultButton(), dialogs_.Asked[0].Cancel);
    EXPECT_FALSE(form_.MayLeave());
    Choose({0});
    dialogs_.Answers = {kDiscard};
    EXPECT_TRUE(form_.MayLeave());
    EXPECT_EQ(Child<QLineEdit>("title").text(), u"Eins"_s);
    EXPECT_EQ(TitleInFile(0), u"Eins"_s);

    Type("title", u"Neu"_s);
    dialogs_.Answers = {kApply};
    EXPECT_TRUE(form_.close());
    EXPECT_EQ(database_.Song(0).Title, u"Neu"_s);
    EXPECT_EQ(TitleInFile(0), u"Neu"_s);
    EXPECT_TRUE(form_.MayLeave());
    EXPECT_EQ(dialogs_.Asked.size(), 4U);
}

TEST_F(TagFormTest, AFileThatCannotBeChangedIsToldAndItsEditStays) {
    Type("album", u"Sommer"_s);
    QFile::remove(database_.Song(1).FileName);
    EXPECT_FALSE(form_.Apply());
    EXPECT_EQ(database_.Song(0).Album, u"Sommer"_s);
    EXPECT_EQ(database_.Song(1).Album, QString());
    ASSERT_EQ(dialogs_.Reports.size(), 1U);
    EXPECT_EQ(dialogs_.Reports[0].Sections[0].Lines.size(), 1);
    EXPECT_EQ(Child<QLineEdit>("album").text(), u"Sommer"_s);

    database_.Clear();
    QApplication::processEvents();
    EXPECT_TRUE(form_.MayLeave());
    EXPECT_EQ(Child<QLineEdit>("album").text(), QString());
}

TEST_F(TagFormTest, WhatAFieldCannotHoldIsNotApplied) {
    Type("year", u"99"_s);
    dialogs_.Answers = {kApply};
    EXPECT_FALSE(form_.MayLeave());
    EXPECT_EQ(dialogs_.Messages, QStringList{u"Das Feld „Jahr“ erwartet vier Ziffern."_s});
    EXPECT_EQ(database_.Song(0).Year, u"0000"_s);
}

TEST_F(TagFormTest, NothingIsClippedAndEveryKeyIsUniqueInAnyFontSize) {
    Type("title", u"Neu"_s);
    WithEveryFontSize([&](int size) {
        for (int i = 0; i < 3; ++i)
            QApplication::processEvents();
        EXPECT_EQ(ClippedCaptions(form_), QStringList()) << size;
        EXPECT_EQ(AmbiguousKeys(form_), QStringList()) << size;
    });
}

}  // namespace
