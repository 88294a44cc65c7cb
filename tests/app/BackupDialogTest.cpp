#include "app/dialogs/BackupDialog.h"

#include <gtest/gtest.h>

#include <QListWidget>
#include <QPushButton>
#include <QTableView>
#include <QTest>

#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

using Kind = BackupDecision::Kind;

TEST(BackupDialog, KeysDecideAboutTheFilesThatAreMarked) {
    TMusicDatabase database;
    std::vector<BackupCandidates> candidates(3);
    for (const QString& title : {u"Eins"_s, u"Zwei"_s}) {
        TID3Tag song;
        song.FileName = u'/' + title;
        song.Artist = u"Band"_s;
        song.Title = title;
        const SongIndex index = database.AddEntry(song.FileName, song, AddAs::Returning);
        candidates[0].push_back({.Song = database.Songs().HandleOf(index), .Percent = 97.4});
    }
    candidates[1] = {candidates[0][1]};
    const SongHandle one = candidates[0][0].Song;
    const SongHandle two = candidates[0][1].Song;
    const std::vector<BackupFile> files(3);
    BackupDialog dialog(database, files, candidates, u" CD 1 "_s);
    auto& table = *dialog.findChild<QTableView*>(u"files"_s);
    auto& list = *dialog.findChild<QListWidget*>(u"candidates"_s);
    auto& agree = *dialog.findChild<QPushButton*>(u"agree"_s);
    const auto press = [](QWidget& widget, std::initializer_list<Qt::Key> keys) {
        for (const Qt::Key key : keys)
            QTest::keyClick(&widget, key);
    };
    EXPECT_EQ(dialog.MediumName(), u"CD 1"_s);
    EXPECT_EQ(list.item(1)->text(), u"2   097%: Band - Zwei (*)"_s);

    // A key without a candidate decides nothing and stays; a song goes from one file to the other.
    press(table, {Qt::Key_2, Qt::Key_9});
    EXPECT_EQ(table.currentIndex().row(), 1);
    EXPECT_EQ(dialog.Decisions(), (std::vector<BackupDecision>{{Kind::Tie, two}, {}, {Kind::TakeIn, {}}}));
    list.setCurrentRow(0);
    press(list, {Qt::Key_Return});
    EXPECT_EQ(dialog.Decisions()[0].What, Kind::Skip);
    EXPECT_EQ(dialog.Decisions()[1], (BackupDecision{Kind::Tie, two}));
    press(table, {Qt::Key_Up, Qt::Key_Up, Qt::Key_1, Qt::Key_N, Qt::Key_0});
    EXPECT_EQ(dialog.Decisions(), (std::vector<BackupDecision>{{Kind::Tie, one}, {Kind::TakeIn, {}}, {}}));
    EXPECT_EQ(dialog.result(), QDialog::Rejected);  // Return has agreed to nothing

    table.selectAll();
    press(table, {Qt::Key_0});
    EXPECT_FALSE(agree.isEnabled());
    press(table, {Qt::Key_N});
    agree.click();
    EXPECT_EQ(dialog.result(), QDialog::Accepted);
    EXPECT_EQ(dialog.Decisions(), std::vector<BackupDecision>(3, {Kind::TakeIn, {}}));
}
