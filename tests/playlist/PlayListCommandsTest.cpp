#include "MusicManagment/playlist/PlayListMenu.h"
#include "tests/playlist/Playing.h"

using namespace Qt::StringLiterals;

// Loading, saving and the menu.

namespace {

class PlayListCommandsTest : public PlayingTest {
 protected:
    QString File(const QString& name) const { return folder_.Path(name); }
};

}  // namespace

TEST_F(PlayListCommandsTest, AListIsSavedUnderItsNameOrUnderOneThatIsAskedFor) {
    Add(u"ab"_s);
    EXPECT_FALSE(list_.SaveOrAsk());  // cancelled
    dialogs_.Files = {{File(u"x.rukpl"_s)}, {File(u"y.m3u"_s)}};
    EXPECT_TRUE(list_.ClickMenuItem(pcSave));
    EXPECT_EQ(dialogs_.FileDialogs.back().Title, u"PlayList speichern unter"_s);
    EXPECT_EQ(dialogs_.FileDialogs.back().DefaultExtension, u"rukpl"_s);
    EXPECT_TRUE(dialogs_.FileDialogs.back().ConfirmOverwrite);
    list_.Remove(1);
    list_.ClickMenuItem(pcSave);
    EXPECT_EQ(dialogs_.FileDialogs.size(), 2u);
    list_.ClickMenuItem(pcSaveAs);
    EXPECT_EQ(list_.PlayListFileName(), File(u"y.m3u"_s));

    list_.ClickMenuItem(pcNew);
    EXPECT_EQ(list_.Count(), 0);
    EXPECT_TRUE(list_.PlayListFileName().isEmpty());
    EXPECT_TRUE(dialogs_.Questions.isEmpty());
    dialogs_.Files = {{File(u"x.rukpl"_s)}};
    list_.ClickMenuItem(pcOpen);
    EXPECT_EQ(Listed(), u"a"_s);
    EXPECT_TRUE(dialogs_.FileDialogs.back().Filter.startsWith(u"Alle PlayLists|*.rukpl;*.rpl;*.m3u;"_s));
}

TEST_F(PlayListCommandsTest, WhatWasChangedIsNotThrownAwayWithoutAQuestion) {
    Add(u"a"_s);
    list_.ClickMenuItem(pcNew);  // cancelled, as is opening another
    list_.ClickMenuItem(pcOpen);
    EXPECT_EQ(dialogs_.Questions.size(), 2);
    EXPECT_TRUE(dialogs_.FileDialogs.empty());
    EXPECT_EQ(Listed(), u"a"_s);

    const QString standard = File(u"standard.rukpl"_s);
    list_.SetStandardFileName(standard);
    list_.Save(standard);
    list_.PlayEntry(0);
    EXPECT_FALSE(list_.Modified());
    list_.ClickMenuItem(pcNew);  // cancelled: it is in no file that stays
    EXPECT_EQ(Listed(), u"a"_s);
    Add(u"b"_s);
    dialogs_.Answers = {0, 0};
    list_.ClickMenuItem(pcNew);  // the next list would take the place of this one: under which name?
    EXPECT_EQ(Listed(), u"ab"_s);
    dialogs_.Files = {{File(u"x.rukpl"_s)}};
    list_.ClickMenuItem(pcNew);
    EXPECT_EQ(list_.Count(), 0);
    EXPECT_TRUE(QFile::exists(File(u"x.rukpl"_s)));
    Add(u"a"_s);
    dialogs_.Answers = {1};
    list_.ClickMenuItem(pcNew);
    EXPECT_EQ(list_.Count(), 0);
}

TEST_F(PlayListCommandsTest, LoadingBeginsANewListAndTellsOfIt) {
    Add(u"ab"_s);
    PlayOn();
    list_.Enqueue(0);
    list_.Save(File(u"l.pls"_s));
    QString changes;
    list_.OnChange = [&](TPlayList& list, int index, TChangeType change) {
        changes += u"%1/%2/%3 "_s.arg(index).arg(change).arg(list.Count());
    };
    list_.SetPlayListFileName(File(u"l.pls"_s));
    EXPECT_EQ(changes, u"-1/2/0 -1/0/2 "_s);
    EXPECT_TRUE(list_.Queue().isEmpty());
    EXPECT_TRUE(list_.HasNext());
}

TEST_F(PlayListCommandsTest, AFileThatCannotBeReadCostsNothingButItself) {
    Add(u"ab"_s);
    list_.Save(File(u"l.rukpl"_s));
    list_.Enqueue(1);
    Put(u"cut.rukpl"_s, std::string_view("RUKPLYLST\x00\x01\xFF\xFFxx", 15));
    EXPECT_THROW(list_.SetPlayListFileName(File(u"cut.rukpl"_s)), EPlayListException);
    EXPECT_THROW(list_.SetPlayListFileName(File(u"none.rukpl"_s)), EStreamError);
    EXPECT_THROW(list_.SetPlayListFileName(folder_.Path()), EStreamError);
    EXPECT_EQ(Listed(), u"ab"_s);
    EXPECT_EQ(list_.Queue().size(), 1);
    EXPECT_EQ(list_.PlayListFileName(), File(u"l.rukpl"_s));
    // Of an unknown version nothing is known but that it was to be the list.
    Put(u"new.rukpl"_s, std::string_view("RUKPLYLST\x00\x02", 11));
    EXPECT_THROW(list_.SetPlayListFileName(File(u"new.rukpl"_s)), EPlayListException);
    EXPECT_EQ(list_.Count(), 0);
    EXPECT_TRUE(list_.PlayListFileName().isEmpty());
}

TEST_F(PlayListCommandsTest, ASaveThatFailsLeavesNameAndFile) {
    Add(u"a"_s);
    list_.Save(File(u"l.rukpl"_s));
    EXPECT_THROW(list_.Save(File(u"none/l.rukpl"_s)), EStreamError);
    EXPECT_EQ(list_.PlayListFileName(), File(u"l.rukpl"_s));
}

TEST_F(PlayListCommandsTest, OnlyTheNativeFormatKeepsWhatCannotBeResolved) {
    TMusicDatabase database;
    list_.SetMusicDatabase(&database);
    Add(u"a"_s);
    list_.Insert(0, {.Name = u":00000001:\\c.mp3"_s});
    for (const auto& [name, count] : {std::pair(u"l.rukpl"_s, 2), std::pair(u"l.m3u"_s, 1)}) {
        TPlayList loaded;
        list_.Save(File(name));
        loaded.SetPlayListFileName(File(name));
        EXPECT_EQ(loaded.Count(), count) << name.toStdString();
    }
}

TEST_F(PlayListCommandsTest, TheViewSaysWhichEntriesAreMeant) {
    Add(u"aBcd"_s);
    EXPECT_TRUE(list_.ClickMenuItem(pcRemoveSelected));  // no view, nothing selected
    ScriptedView view;
    view.Selected = {0, 3};
    list_.SetView(&view);
    list_.ClickMenuItem(pcRemoveSelected);
    EXPECT_EQ(Listed(), u"Bc"_s);
    list_.ClickMenuItem(pcRemoveUnavailable);
    EXPECT_EQ(Listed(), u"c"_s);
    dialogs_.Folders = {folder_.Path(u"links"_s)};
    list_.ClickMenuItem(pcExportAsLinks);
    EXPECT_EQ(dialogs_.FolderCaptions, QStringList{u"PlayList als Link-Liste speichern"_s});
    EXPECT_EQ(dialogs_.StartFolders, QStringList{QDir::currentPath()});
    EXPECT_TRUE(QFile::exists(folder_.Path(u"links/c.wav"_s)));
}
