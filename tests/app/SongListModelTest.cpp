#include "app/models/SongListModel.h"

#include <gtest/gtest.h>

#include <QAbstractItemModelTester>
#include <QItemSelectionModel>
#include <QSignalSpy>
#include <random>

#include "app/models/SongColumns.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"
#include "tests/app/Songs.h"

using namespace Qt::StringLiterals;

namespace {

QString Shown(const QAbstractItemModel& model, int row, SongColumnId column = SongColumnId::Title) {
    return model.index(row, static_cast<int>(column)).data().toString();
}

QStringList ShownTitles(const QAbstractItemModel& model) {
    QStringList titles;
    for (int row = 0; row < model.rowCount(); ++row)
        titles << Shown(model, row);
    return titles;
}

QStringList TitlesOf(const TMusicDatabase& database) {
    QStringList titles;
    for (const auto& song : database.Songs())
        titles << u"[CD] "_s + song->Title;
    return titles;
}

class SongListModelTest : public testing::Test {
 protected:
    SongListModelTest() { database_.SetSortType(stTitle); }

    void AddSongs(const QStringList& titles) {
        for (const QString& title : titles)
            AddSong(database_, title);
        model_.SyncViews();
    }

    TMusicDatabase database_;
    SongListModel model_{database_};
    QAbstractItemModelTester tester_{&model_, QAbstractItemModelTester::FailureReportingMode::Fatal};
};

TEST_F(SongListModelTest, ManyInsertionsAreToldInOneStep) {
    AddSongs({u"M"_s});
    QSignalSpy inserted(&model_, &QAbstractItemModel::rowsInserted);
    QSignalSpy laidOut(&model_, &QAbstractItemModel::layoutChanged);
    for (int i = 0; i < 500; ++i)
        AddSong(database_, (i % 2 == 0 ? u"A%1"_s : u"Z%1"_s).arg(i));
    EXPECT_EQ(model_.rowCount(), 1);
    EXPECT_EQ(ShownTitles(model_), QStringList{u"[CD] M"_s});

    model_.SyncViews();
    EXPECT_EQ(inserted.count(), 1);
    EXPECT_EQ(laidOut.count(), 1);
    EXPECT_EQ(ShownTitles(model_), TitlesOf(database_));
}

TEST_F(SongListModelTest, RowsShowTheirSongsWhateverHappensBetweenTwoSyncs) {
    std::mt19937 random(99);
    const auto pick = [&](int count) { return std::uniform_int_distribution<int>(0, count - 1)(random); };
    AddSongs({u"D"_s, u"H"_s, u"K"_s, u"P"_s, u"S"_s});
    for (int round = 0; round < 100; ++round) {
        QStringList expected = ShownTitles(model_);
        const QPersistentModelIndex held = model_.index(pick(model_.rowCount()), 0);
        const QString heldTitle = Shown(model_, held.row());
        for (int change = 0; change < 6; ++change) {
            const int kind = pick(5);
            if (kind < 3 || database_.Count() < 3) {
                AddSong(database_, u"%1%2"_s.arg(QChar(u'A' + pick(26))).arg(round * 10 + change));
                continue;
            }
            const int row = pick(database_.Count());
            const QString before = u"[CD] "_s + database_.Song(row).Title;
            QString after;  // a removed song's row shows nothing
            if (kind == 3) {
                database_.RemoveEntry(row);
            } else {
                TID3Tag song = database_.Song(row);
                song.Title = u"%1%2"_s.arg(QChar(u'A' + pick(26))).arg(round * 10 + change);
                after = u"[CD] "_s + song.Title;
                database_.UpdateEntry(row, song);
            }
            const auto at = expected.indexOf(before);
            if (at >= 0) expected[at] = after;
        }
        ASSERT_EQ(ShownTitles(model_), expected);
        const QString heldNow = Shown(model_, held.row());
        model_.SyncViews();
        ASSERT_EQ(ShownTitles(model_), TitlesOf(database_));
        ASSERT_EQ(held.isValid(), !heldNow.isEmpty()) << heldTitle.toStdString();
        if (held.isValid()) {
            ASSERT_EQ(Shown(model_, held.row()), heldNow);
        }
    }
}

TEST_F(SongListModelTest, SelectedSongsStaySelectedWhenSorted) {
    AddSongs({u"A"_s, u"B"_s, u"C"_s, u"D"_s, u"E"_s});
    QItemSelectionModel selection(&model_);
    const auto rows = QItemSelectionModel::Select | QItemSelectionModel::Rows;
    selection.select(model_.index(0, 0), rows);
    selection.select(model_.index(3, 0), rows);
    selection.setCurrentIndex(model_.index(3, 0), QItemSelectionModel::NoUpdate);

    model_.SetOrder({stTitle, sstGATL, true, 0});
    EXPECT_EQ(ShownTitles(model_).first(), u"[CD] E"_s);
    QStringList selected;
    for (const QModelIndex& index : selection.selectedRows())
        selected << Shown(model_, index.row());
    selected.sort();
    EXPECT_EQ(selected, QStringList({u"[CD] A"_s, u"[CD] D"_s}));
    EXPECT_EQ(Shown(model_, selection.currentIndex().row()), u"[CD] D"_s);
}

TEST_F(SongListModelTest, ARefusedSortLeavesTheListAlone) {
    ScriptedDialogs dialogs;
    AddSongs({u"A"_s, u"B"_s});
    {
        const ProgressRun run(database_, u"Test"_s);
        EXPECT_THROW(model_.SetOrder({stTitle, sstGATL, true, 0}), EMusicDatabaseException);
    }
    database_.BeginBusy();
    EXPECT_THROW(model_.SetOrder({stTitle, sstGATL, true, 0}), EMusicDatabaseException);
    database_.EndBusy();
    EXPECT_EQ(ShownTitles(model_), QStringList({u"[CD] A"_s, u"[CD] B"_s}));
}

TEST_F(SongListModelTest, FollowsClearingAndWholesaleChanges) {
    AddSongs({u"A"_s, u"B"_s});
    AddSong(database_, u"C"_s);
    database_.SetSortBackwards(true);  // not through the model, and with a change that is not told yet
    EXPECT_EQ(ShownTitles(model_), QStringList({u"[CD] C"_s, u"[CD] B"_s, u"[CD] A"_s}));
    AddSong(database_, u"D"_s);
    database_.Clear();
    EXPECT_EQ(model_.rowCount(), 0);
}

TEST_F(SongListModelTest, ShowsASongInGermanTexts) {
    TID3Tag song = CdSong(u"Lied"_s, 185);
    song.Artist = u"Die Band"_s;
    song.Album = u"Das Album"_s;
    song.Year = u"1999"_s;
    song.MainGenre = 8;
    song.Genre = 17;
    song.ChannelMode = 3;
    song.Flags = sfBurned | sfRemixed;
    song.Track = 7;
    song.BitRate = 192;
    song.SampleRate = 44100;
    song.MPEGLayer = u"MPEG 1.0 Layer III"_s;
    song.PlayCount = 12;
    song.Comment = u"gut"_s;
    song.AddTime = 45292.5;
    database_.AddEntry(QString(), song);
    song = TID3Tag();
    song.FileName = QCoreApplication::applicationFilePath();
    song.Title = u"Z"_s;
    song.Year = u"0000"_s;
    song.AddTime = 1;
    database_.AddEntry(QString(), song);
    model_.SyncViews();

    const QStringList captions = {
        u"Titel"_s,       u"Artist"_s,    u"Album"_s,   u"Jahr"_s,       u"Länge"_s,  u"Genre"_s,
        u"ID3-Genre"_s,   u"Track"_s,     u"Bitrate"_s, u"Abtastrate"_s, u"Kanäle"_s, u"Format"_s,
        u"Beliebtheit"_s, u"Kommentar"_s, u"Datum"_s,   u"Flags"_s,      u"Pfad"_s};
    const QStringList first = {u"[CD] Lied"_s,
                               u"Die Band"_s,
                               u"Das Album"_s,
                               u"1999"_s,
                               u"3:05"_s,
                               u"Rock/Pop"_s,
                               u"Rock"_s,
                               u"7"_s,
                               u"192 KBit/s"_s,
                               u"44.1 kHz"_s,
                               u"Joint Stereo"_s,
                               u"MPEG 1.0 Layer III"_s,
                               u"12"_s,
                               u"gut"_s,
                               u"01.01.2024 12:00"_s,
                               u"Auf CD gebrannt, Remixed"_s,
                               u":00000001:\\Lied.mp3"_s};
    QStringList shownCaptions;
    QStringList shown;
    for (int column = 0; column < model_.columnCount(); ++column) {
        shownCaptions << model_.headerData(column, Qt::Horizontal).toString();
        shown << model_.index(0, column).data().toString();
    }
    EXPECT_EQ(shownCaptions, captions);
    EXPECT_EQ(shown, first);
    EXPECT_EQ(Shown(model_, 1), u"Z"_s);
    EXPECT_EQ(Shown(model_, 1, SongColumnId::Year), QString());
    for (const SongColumnId column :
         {SongColumnId::Track, SongColumnId::Genre, SongColumnId::Channels, SongColumnId::Flags})
        EXPECT_EQ(Shown(model_, 1, column), QString());
}

}  // namespace
