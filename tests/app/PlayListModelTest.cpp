#include "app/models/PlayListModel.h"

#include <gtest/gtest.h>

#include <QFont>
#include <QMimeData>
#include <QTest>
#include <QUrl>

#include "tests/PrintQt.h"
#include "tests/ScriptedVolumes.h"
#include "tests/app/Songs.h"
#include "tests/database/SongFolder.h"
#include "tests/playlist/ScriptedPlayer.h"

using namespace Qt::StringLiterals;

namespace {

class PlayListModelTest : public testing::Test {
 protected:
    PlayListModelTest() {
        list_.SetMusicDatabase(&database_);
        list_.SetPlaySound(&player_);
        for (const QString& name : {u"a"_s, u"b"_s, u"c"_s, u"d"_s})
            list_.Insert(list_.Count(), {.Name = File(name)});
    }
    ~PlayListModelTest() override { list_.SetPlaySound(nullptr); }

    // A song that is there.
    QString File(const QString& name) { return folder_.Put(name + u".mp3"_s, QByteArray()); }
    QVariant Data(int row, PlayListColumn column, int role = Qt::DisplayRole) const {
        return model_.data(model_.index(row, static_cast<int>(column)), role);
    }
    QStringList Titles() const {
        QStringList titles;
        for (int row = 0; row < model_.rowCount(); ++row)
            titles << Data(row, PlayListColumn::Title).toString();
        return titles;
    }
    bool IsBold(int row) const {
        return Data(row, PlayListColumn::Title, Qt::FontRole).value<QFont>().bold();
    }
    bool IsGrey(int row) const { return Data(row, PlayListColumn::Title, Qt::ForegroundRole).isValid(); }

    SongFolder folder_;
    TMusicDatabase database_;
    TPlayList list_;
    ScriptedPlayer player_;
    PlayListModel model_{list_};
};

TEST_F(PlayListModelTest, FollowsEveryChangeOfTheList) {
    list_.Insert(1, {.Name = u"/x/neu.mp3"_s});
    EXPECT_EQ(Titles(), QStringList({u"a"_s, u"neu"_s, u"b"_s, u"c"_s, u"d"_s}));
    list_.Remove({0, 3});
    EXPECT_EQ(Titles(), QStringList({u"neu"_s, u"b"_s, u"d"_s}));
    list_.Move({2}, 0);
    EXPECT_EQ(Titles(), QStringList({u"d"_s, u"neu"_s, u"b"_s}));
    list_.Clear();
    EXPECT_EQ(model_.rowCount(), 0);
}

TEST_F(PlayListModelTest, ShowsArtistTitleAndLengthAndElseTheFilesName) {
    TID3Tag song = CdSong(u"Lied"_s, 125);
    song.Artist = u"Band"_s;
    list_.Insert(0, {.Name = song.FileName, .Record = song});
    EXPECT_EQ(Data(0, PlayListColumn::Title), u"Band - Lied"_s);
    EXPECT_EQ(Data(0, PlayListColumn::Length), u"2:05"_s);
    song.Artist.clear();
    list_.Insert(0, {.Name = song.FileName, .Record = song});
    EXPECT_EQ(Data(0, PlayListColumn::Title), u"Lied"_s);
    list_.Insert(0, {.Name = u"/Musik/v1.2 final.mp3"_s});
    EXPECT_EQ(Data(0, PlayListColumn::Title), u"v1.2 final"_s);
    EXPECT_EQ(Data(0, PlayListColumn::Length), QString());
    list_.Insert(0, {.Name = u"http://radio.example/live.mp3"_s});
    EXPECT_EQ(Data(0, PlayListColumn::Title), u"http://radio.example/live.mp3"_s);
}

TEST_F(PlayListModelTest, TheCurrentSongStaysMarkedWhileOthersComeAndGo) {
    ASSERT_TRUE(list_.PlayEntry(2));
    EXPECT_TRUE(IsBold(2));
    EXPECT_FALSE(Data(2, PlayListColumn::Number, Qt::DecorationRole).isNull());

    list_.Insert(0, {.Name = u"/x"_s});
    list_.Insert(1, {.Name = list_.CurrentSong()});  // the same song once more
    EXPECT_EQ(model_.CurrentRow(), 4);
    list_.Remove(0);
    EXPECT_EQ(model_.CurrentRow(), 3);
    list_.Move({3}, 0);
    EXPECT_TRUE(IsBold(0));
    EXPECT_FALSE(IsBold(1));
    list_.Remove({0, 1});
    EXPECT_EQ(model_.CurrentRow(), -1);
    list_.Insert(1, {.Name = list_.CurrentSong()});
    EXPECT_EQ(model_.CurrentRow(), 1);
}

TEST_F(PlayListModelTest, QueuedEntriesCarryTheirPlace) {
    list_.Enqueue(3);
    list_.Enqueue(1);
    EXPECT_EQ(Data(3, PlayListColumn::Title, PlayListModel::QueueRole), 1);
    EXPECT_EQ(Data(1, PlayListColumn::Title, PlayListModel::QueueRole), 2);
    EXPECT_FALSE(Data(0, PlayListColumn::Title, PlayListModel::QueueRole).isValid());
    EXPECT_EQ(Data(1, PlayListColumn::Number, Qt::AccessibleTextRole), u"2, Warteschlange 2"_s);

    list_.Remove(3);
    EXPECT_EQ(Data(1, PlayListColumn::Title, PlayListModel::QueueRole), 1);
}

TEST_F(PlayListModelTest, OnlyFilesThatWereLookedForAndNotFoundAreGrey) {
    list_.Insert(1, {.Name = folder_.Path(u"fehlt.mp3"_s)});
    list_.Insert(2, {.Name = u":00000001:\\a.mp3"_s});
    list_.Insert(3, {.Name = u"http://radio.example/live.mp3"_s});
    list_.Insert(list_.Count(), {.Name = folder_.Path(u"fehlt auch.mp3"_s)});
    EXPECT_FALSE(IsGrey(1));

    model_.LookForFiles(0, 4);
    EXPECT_TRUE(QTest::qWaitFor([&] { return IsGrey(1); }));
    EXPECT_FALSE(IsGrey(0));
    EXPECT_TRUE(IsGrey(2));
    EXPECT_FALSE(IsGrey(3));
    EXPECT_FALSE(IsGrey(7));

    ScriptedVolumes volumes;
    volumes.Mount(folder_.Path(), 1);
    database_.SetModernMedia(true);
    QStringList shown;
    QObject::connect(&model_, &PlayListModel::dataChanged, &model_,
                     [&](const QModelIndex& first) { shown << QString::number(first.row()); });
    model_.LookForFiles(0, 4);
    EXPECT_FALSE(IsGrey(2));
    EXPECT_EQ(shown, QStringList{u"2"_s});
}

// --- Drag and drop ---

TEST_F(PlayListModelTest, DraggedSongsAreFilesForOthersAndSongsForAPlayList) {
    const TID3Tag onCd = CdSong(u"Auf CD"_s);
    AddSong(database_, u"Auf CD"_s);
    const QString file = folder_.Path(u"a b#ü.mp3"_s);
    const SongMimeData data({{.Name = file}, {.Name = onCd.FileName, .Hint = 7}, {.Name = u"http://h/x"_s}});
    EXPECT_EQ(data.urls(), QList<QUrl>({QUrl::fromLocalFile(file), QUrl(u"http://h/x"_s)}));

    const DroppedSongs drop = ReadDrop(data);
    EXPECT_EQ(InsertDrop(list_, 1, drop), 3);
    EXPECT_EQ(list_.Entry(1).Name, file);
    ASSERT_EQ(list_.Entry(2).Name, onCd.FileName);
    ASSERT_TRUE(list_.Entry(2).Record.has_value());
    EXPECT_EQ(list_.Entry(2).Record->Title, u"Auf CD"_s);
    EXPECT_EQ(list_.Entry(3).Name, u"http://h/x"_s);

    QMimeData foreign;
    foreign.setUrls({QUrl::fromLocalFile(u"/Musik/x.mp3"_s), QUrl(u"https://example.org/"_s)});
    EXPECT_EQ(ReadDrop(foreign).Paths, QStringList(u"/Musik/x.mp3"_s));
}

}  // namespace
