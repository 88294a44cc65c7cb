#include "MusicManagment/database/MusicManagment.h"

#include <gtest/gtest.h>

#include <limits>

#include "CommonRUKTools/Clock.h"
#include "MusicManagment/database/CollectionEdit.h"
#include "tests/ErrorOf.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"
#include "tests/database/Listing.h"
#include "tests/database/RecordingTrash.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

namespace {

QString Number(qint64 value) {
    return QString::number(value);
}

// A song on a catalogued CD, so that no file is looked for.
TID3Tag Song(const QString& title, const QString& artist = u"Band"_s, quint8 genre = 0) {
    TID3Tag song;
    song.FileName = u":00000001:\\"_s + artist + title;
    song.Title = title;
    song.Artist = artist;
    song.Album = u"Album"_s;
    song.Year = u"1985"_s;
    song.Length = 100;
    song.MainGenre = genre;
    song.AddTime = 40'000;
    return song;
}

// Writes down every event in one list.
class Log {
 public:
    explicit Log(TMusicDatabase& database) {
        database.OnModifiedChange = [this](auto& d) { lines_ << u"modified "_s + Number(d.Modified()); };
        database.OnChange = [this](auto&, SongIndex index, TChangeType change) {
            lines_ << u"change %1 %2"_s.arg(index).arg(change);
        };
        database.OnClear = [this](auto&) { lines_ << u"clear"_s; };
        database.OnPrepareMultiAdd = [this](auto&, int count) { lines_ << u"prepare "_s + Number(count); };
        database.OnOverviewChanged = [this](auto&) { lines_ << u"overview"_s; };
        database.OnOverviewInsert = [this](auto&, TOVType type, int row, const QString& caption, int count) {
            lines_ << u"insert %1 %2 %3 %4"_s.arg(type).arg(row).arg(caption).arg(count);
        };
        database.OnOverviewDelete = [this](auto&, TOVType type, int row) {
            lines_ << u"delete %1 %2"_s.arg(type).arg(row);
        };
        database.OnOverviewUpdate = [this](auto&, TOVType type, int row, int count) {
            lines_ << u"update %1 %2 %3"_s.arg(type).arg(row).arg(count);
        };
        database.OnStartProgress = [this](auto&) { lines_ << u"start"_s; };
        database.OnResetProgress = [this](auto&) { lines_ << u"reset"_s; };
        database.OnEndProgress = [this](auto&) { lines_ << u"end"_s; };
        database.OnCaptionChanged = [this](auto& d) { lines_ << u"caption "_s + d.Caption(); };
    }

    QStringList Take() { return std::exchange(lines_, {}); }

 private:
    QStringList lines_;
};

class MusicManagmentTest : public testing::Test {
 protected:
    MusicManagmentTest() { database_.SetAsynchronous(false); }

    ScriptedDialogs dialogs_;
    TMusicDatabase database_;
    Log log_{database_};
};

}  // namespace

TEST_F(MusicManagmentTest, AnAddedSongIsCountedThenTold) {
    EXPECT_EQ(database_.AddEntry(QString(), Song(u"B"_s, u"Band"_s, 3)), 0);
    EXPECT_EQ(log_.Take(), (QStringList{u"modified 1"_s, u"insert 0 0 Band 1"_s, u"insert 1 0 Album 1"_s,
                                        u"insert 2 0 In den 80ern 1"_s, u"insert 3 0 1 bis 2 Minuten 1"_s,
                                        u"update 4 3 1"_s, u"change 0 1"_s}));
    EXPECT_EQ(database_.AddEntry(u":00000001:\\other"_s, Song(u"A"_s, u"Band"_s, 3)), 0);
    EXPECT_EQ(log_.Take(), (QStringList{u"update 0 0 2"_s, u"update 1 0 2"_s, u"update 2 0 2"_s,
                                        u"update 3 0 2"_s, u"update 4 3 2"_s, u"change 0 1"_s}));
    EXPECT_EQ(database_.Song(0).FileName, u":00000001:\\other"_s);
}

TEST_F(MusicManagmentTest, WhatIsRefusedChangesNothing) {
    const SongFolder songs;
    const RecordingTrash trash;
    database_.BannList().Insert(u"Band - Ohrwurm"_s);
    TID3Tag banned = Song(u"Ohrwurm"_s);
    banned.FileName = songs.Add(u"x.wav"_s);

    database_.BeginBusy();
    EXPECT_EQ(database_.AddEntry(QString(), Song(u"A"_s)), -1);
    database_.EndBusy();
    database_.SetReadOnly(true);
    EXPECT_EQ(database_.AddEntry(QString(), Song(u"A"_s)), -1);
    database_.SetReadOnly(false);
    EXPECT_EQ(database_.AddEntry(songs.Path(u"gone.mp3"_s), Song(u"A"_s)), -1);
    EXPECT_EQ(database_.AddEntry(QString(), banned), -1);
    EXPECT_TRUE(trash.Taken.isEmpty());
    database_.SetAutoDelBannedFiles(true);
    EXPECT_EQ(database_.AddEntry(QString(), banned), -1);
    EXPECT_EQ(trash.Taken, QStringList{banned.FileName});
    EXPECT_EQ(log_.Take(), QStringList());
    EXPECT_EQ(database_.Count(), 0);

    banned.Title = u"ohrwurm"_s;
    EXPECT_EQ(database_.AddEntry(QString(), banned), 0) << "the ban list tells cases apart";
}

TEST_F(MusicManagmentTest, ImpossibleValuesAreReplaced) {
    for (const quint8 genre : {quint8{20}, quint8{200}, quint8{255}})
        EXPECT_EQ(database_.Song(database_.AddEntry(QString(), Song(u"x"_s, u"y"_s, genre))).MainGenre, 0);
    TID3Tag song = Song(u"z"_s);
    for (const double time : {0.0, std::numeric_limits<double>::quiet_NaN()}) {
        song.AddTime = time;
        EXPECT_NEAR(database_.Song(database_.AddEntry(QString(), song)).AddTime, CurrentClock().Now(), 1);
    }
    EXPECT_EQ(database_.Genres()[0], 5);
}

TEST_F(MusicManagmentTest, LoadingKeepsTheOrderAndTheNextSongPutsAllInPlace) {
    database_.BeginLoading();
    for (const QString& title : {u"C"_s, u"A"_s, u"D"_s})
        database_.AddEntry(QString(), Song(title));
    database_.EndLoading();
    EXPECT_EQ(TitlesOf(database_), (QStringList{u"C"_s, u"A"_s, u"D"_s}));
    EXPECT_FALSE(log_.Take().contains(u"change 0 1"_s));
    EXPECT_EQ(database_.AddEntry(QString(), Song(u"B"_s)), 1);
    EXPECT_EQ(TitlesOf(database_), (QStringList{u"A"_s, u"B"_s, u"C"_s, u"D"_s}));
    EXPECT_EQ(log_.Take().filter(u"change"_s), (QStringList{u"change -1 0"_s, u"change 1 1"_s}));
}

TEST_F(MusicManagmentTest, AChangedSongIsCountedAnewAndMoved) {
    for (const QString& title : {u"A"_s, u"B"_s, u"C"_s})
        database_.AddEntry(QString(), Song(title));
    log_.Take();
    EXPECT_EQ(database_.UpdateEntry(0, Song(u"D"_s, u"Band"_s, 2)), 2);
    EXPECT_EQ(TitlesOf(database_), (QStringList{u"B"_s, u"C"_s, u"D"_s}));
    EXPECT_EQ(log_.Take(), (QStringList{u"update 4 0 2"_s, u"update 4 2 1"_s, u"change 2 0"_s}));
    EXPECT_EQ(database_.Genres()[0], 2);
    EXPECT_EQ(database_.IndexOf(u":00000001:\\BandA"_s), -1);
    EXPECT_EQ(database_.IndexOf(u":00000001:\\BandD"_s), 2);
    // Only what a change changes is told: the year stays in its decade.
    TID3Tag live = Song(u"D"_s, u"Band"_s, 2);
    live.Album = u"Live"_s;
    live.Year = u"1989"_s;
    EXPECT_EQ(database_.UpdateEntry(2, live), 2);
    EXPECT_EQ(log_.Take(), (QStringList{u"update 1 0 2"_s, u"insert 1 1 Live 1"_s, u"change 2 0"_s}));
    EXPECT_EQ(database_.UpdateEntry(3, Song(u"X"_s)), -1);
    EXPECT_EQ(database_.UpdateEntry(-1, Song(u"X"_s)), -1);
    database_.SetReadOnly(true);
    EXPECT_EQ(database_.UpdateEntry(0, Song(u"X"_s)), -1);
    EXPECT_FALSE(database_.RemoveEntry(0));
    EXPECT_EQ(TitlesOf(database_), (QStringList{u"B"_s, u"C"_s, u"D"_s}));
}

TEST_F(MusicManagmentTest, ARemovedSongLeavesItsGroups) {
    database_.AddEntry(QString(), Song(u"A"_s, u"Eins"_s));
    database_.AddEntry(QString(), Song(u"B"_s, u"Zwei"_s));
    database_.SetModified(false);
    log_.Take();
    EXPECT_TRUE(database_.RemoveEntry(0));
    EXPECT_EQ(log_.Take(),
              (QStringList{u"delete 0 0"_s, u"update 1 0 1"_s, u"update 2 0 1"_s, u"update 3 0 1"_s,
                           u"update 4 0 1"_s, u"modified 1"_s, u"change 0 2"_s}));
    EXPECT_EQ(TitlesOf(database_), QStringList{u"B"_s});
    EXPECT_FALSE(database_.RemoveEntry(1));
}

TEST_F(MusicManagmentTest, ClearingLeavesTheGenresAndTellsWhatWasAskedFor) {
    const auto fill = [this] {
        database_.AddEntry(QString(), Song(u"A"_s));
        database_.SetFileName(u"/x.tsdb"_s);
        database_.SetUpdateFolders({u"/music"_s});
        log_.Take();
    };
    fill();
    database_.BeginBusy();
    database_.Clear();
    EXPECT_EQ(database_.Count(), 1);
    EXPECT_EQ(log_.Take(), QStringList());
    database_.EndBusy();

    database_.Clear();
    EXPECT_EQ(log_.Take(), (QStringList{u"modified 0"_s, u"overview"_s, u"change -1 2"_s, u"clear"_s}));
    EXPECT_EQ(database_.Count() + database_.Artists().Count() + database_.UpdateFolders().size(), 0);
    EXPECT_EQ(database_.Groups().RowCount(ovGenre), 20);
    EXPECT_EQ(database_.Genres()[0], 0);
    EXPECT_TRUE(database_.FileName().isEmpty());

    fill();
    database_.Clear(false, true);
    EXPECT_EQ(log_.Take(), (QStringList{u"modified 0"_s, u"overview"_s}));
    EXPECT_EQ(database_.FileName(), u"/x.tsdb"_s);
}

TEST_F(MusicManagmentTest, AnEntryIsFoundByPlaceByPathOrReadFromItsFile) {
    const SongFolder songs;
    database_.AddEntry(QString(), Song(u"A"_s));
    EXPECT_EQ(database_.GetEntry(0).Title, u"A"_s);
    EXPECT_EQ(database_.GetEntry(-1, u":00000001:\\BandA"_s).Title, u"A"_s);
    EXPECT_EQ(database_.GetEntry(-1, songs.Add(u"Band - Neu.wav"_s)).Title, u"Neu"_s);
    EXPECT_EQ(database_.Count(), 1);
    EXPECT_THROW(database_.GetEntry(1), EMusicDatabaseException);
    EXPECT_EQ(ErrorOf([&] { database_.RequireIndexOf(u"/x.mp3"_s); }),
              u"Kann den Eintrag /x.mp3 nicht mehr finden."_s);
}

TEST_F(MusicManagmentTest, ARunBeginsAndEndsWithItsObject) {
    {
        const ProgressRun run(database_, u"Test"_s);
        EXPECT_EQ(log_.Take(), (QStringList{u"reset"_s, u"start"_s, u"caption MusicDatabase v6.0 - Test"_s}));
        EXPECT_TRUE(database_.ProgressRunning() && database_.MenuLocked());
        EXPECT_THROW(database_.StartProgress(u"second"_s, true), EAbort);
        EXPECT_EQ(
            dialogs_.Messages,
            QStringList{
                u"Warten Sie, bis der gerade laufende Vorgang beendet wurde oder brechen Sie ihn ab."_s});
        EXPECT_EQ(log_.Take(), QStringList());
        database_.RequestAbort();
    }
    EXPECT_EQ(log_.Take(), (QStringList{u"caption MusicDatabase v6.0"_s, u"end"_s, u"reset"_s}));
    EXPECT_FALSE(database_.ProgressRunning() || database_.MenuLocked());
    EXPECT_FALSE(database_.Progress({}));
    const ProgressRun unlocked(database_, u"Test"_s, Operation::Commands::Stay);
    EXPECT_FALSE(database_.MenuLocked());
}

TEST_F(MusicManagmentTest, ProgressCountsUnknownsAndPercentages) {
    struct Case {
        ProgressPoint Given;
        qint64 Cur, Max;
        int Percent, SubPercent;
    };
    const Case cases[] = {{{.Cur = 5, .Max = 20}, 5, 20, 25, -1},
                          {{.Cur = -1, .Max = -1}, 0, 0, -1, -1},
                          {{.Cur = 30, .Max = -1}, 30, 100, 30, -1},
                          {{.Cur = 1, .Max = 3, .CurSub = 2, .MaxSub = 4}, 1, 3, 33, 50},
                          {{.Cur = 7, .Max = 0, .CurSub = 9, .MaxSub = -1}, 7, 0, -1, 9}};
    int reported = 0;
    database_.OnProgress = [&](auto&, const ProgressPoint&) { ++reported; };
    for (const Case& c : cases) {
        database_.Progress(c.Given);
        EXPECT_EQ(database_.LastProgress().Cur, c.Cur);
        EXPECT_EQ(database_.LastProgress().Max, c.Max);
        EXPECT_EQ(database_.MainPercent(), c.Percent);
        EXPECT_EQ(database_.SubPercent(), c.SubPercent);
    }
    database_.Progress({.Cur = 1, .Max = 2}, false, false);
    EXPECT_EQ(reported, 5);
    database_.RequestAbort();
    EXPECT_TRUE(database_.Progress({}));
    EXPECT_TRUE(database_.Progress({}, true));
    EXPECT_FALSE(database_.Progress({}));
}

TEST_F(MusicManagmentTest, AutoSaveTakesIntervalsAndTheTwoStops) {
    EXPECT_EQ(ErrorOf([&] { database_.SetAutoSave(-2); }), u"-2 ist kein gültiges AutoSave-Intervall."_s);
    EXPECT_EQ(database_.AutoSave(), 0);
    for (const int stop : {0, -1}) {
        database_.SetAutoSave(60'000);
        EXPECT_TRUE(database_.AutoSaveTimerActive());
        database_.SetAutoSave(stop);
        EXPECT_FALSE(database_.AutoSaveTimerActive());
        EXPECT_EQ(database_.AutoSave(), stop);
    }
}

TEST_F(MusicManagmentTest, TheAutomaticSaveNeedsANameAndDisturbsNoRun) {
    const SongFolder songs;
    database_.AddEntry(QString(), Song(u"A"_s));
    database_.SetAutoSave(60'000);
    database_.AutoSaveTick();
    EXPECT_TRUE(database_.Modified());
    database_.SetFileName(songs.Path(u"x.tsdb"_s));
    {
        const ProgressRun run(database_, u"Test"_s);
        database_.AutoSaveTick();
    }
    EXPECT_FALSE(QFile::exists(database_.FileName()));
    database_.AutoSaveTick();
    EXPECT_TRUE(QFile::exists(database_.FileName()));
    EXPECT_FALSE(database_.Modified());
    EXPECT_TRUE(dialogs_.Messages.empty() && dialogs_.FileDialogs.empty());

    database_.SetFileName(songs.Path(u"no folder/x.tsdb"_s));
    database_.AutoSaveTick();
    EXPECT_EQ(dialogs_.Messages.size(), 1) << "a save that fails is told, as nobody called the command";
    EXPECT_TRUE(database_.AutoSaveTimerActive());
}

TEST_F(MusicManagmentTest, GenreFoldersAreTwentyNamesWithoutSeparators) {
    database_.SetMP3MoveSubDirs({u"Rock/"_s, u"Pop\\"_s, u"/"_s});
    EXPECT_EQ(database_.MP3MoveSubDirs().first(4), (QStringList{u"Rock"_s, u"Pop"_s, u"/"_s, u"Genre #3"_s}));
    database_.SetMP3MoveSubDirs(QStringList(25, u"zu viele"_s));
    EXPECT_EQ(database_.MP3MoveSubDirs().size(), 20);
    database_.SetMP3MoveSubDirs({u"Härte"_s});
    EXPECT_EQ(database_.AudioReadOptions().ExcludedArtistFolders.first(2),
              (QStringList{u"HÄRTE"_s, u"GENRE #1"_s}));
}

TEST_F(MusicManagmentTest, CdNamesAreSortedAndOneForEachSerial) {
    database_.SetCDNames({{u"Zulu"_s, 7}, {u"Alt"_s, 3}, {u"Ohne"_s, 0}, {u"Neu"_s, 3}, {u"Äpfel"_s, 9}});
    QStringList names;
    for (const CdName& cd : database_.CDNames())
        names << cd.Name + Number(cd.Serial);
    EXPECT_EQ(names, (QStringList{u"Äpfel9"_s, u"Neu3"_s, u"Zulu7"_s}));
}

TEST_F(MusicManagmentTest, ANewOrderSortsOnceAndIsRefusedWhileBusy) {
    for (const QString& title : {u"A"_s, u"B"_s, u"C"_s})
        database_.AddEntry(QString(), Song(title));
    log_.Take();
    database_.SetSortBackwards(true);
    EXPECT_EQ(TitlesOf(database_), (QStringList{u"C"_s, u"B"_s, u"A"_s}));
    EXPECT_EQ(log_.Take(), QStringList{u"change -1 0"_s});
    database_.SetSortBackwards(true);
    database_.SetSortType(stGenre);
    database_.SetSubSortType(sstGATL);
    EXPECT_EQ(log_.Take(), QStringList());
    database_.BeginBusy();
    for (const auto& change : std::initializer_list<std::function<void()>>{
             [&] { database_.SetSortType(stTitle); }, [&] { database_.SetSubSortType(sstPath); },
             [&] { database_.SetSortBackwards(false); }, [&] { database_.Resort(); }})
        EXPECT_EQ(ErrorOf(change), u"Umsortieren der Datenbank ist momentan nicht möglich."_s);
    EXPECT_EQ(database_.SortType(), stGenre);
    EXPECT_TRUE(database_.SortBackwards());
}

// The index over the paths is held against a look at every song, through many changes.
TEST(SongListTest, ThePathIndexFollowsEveryChange) {
    SongList list;
    std::uint32_t state = 1;
    const auto below = [&state](std::uint32_t limit) {
        state = state * 1'664'525 + 1'013'904'223;
        return (state >> 8) % limit;
    };
    const auto path = [&] { return QString::number(below(12)); };
    const auto place = [&] {
        return static_cast<SongIndex>(below(static_cast<std::uint32_t>(list.Count())));
    };
    for (int step = 0; step < 3000; ++step) {
        TID3Tag song;
        song.FileName = path();
        const auto kind = below(5);
        if (list.Count() == 0 || kind == 0)
            list.Append(song);
        else if (kind == 1)
            list.Remove(place());
        else if (kind == 2)
            list.Exchange(place(), song);
        else if (kind == 3)
            list.Move(place(), place());
        else
            list.PutAll(list.TakeAll());
        const QString wanted = path();
        const bool there = std::any_of(list.begin(), list.end(),
                                       [&](const auto& entry) { return entry->FileName == wanted; });
        const TID3Tag* const found = list.Find(wanted);
        ASSERT_EQ(found != nullptr, there) << "step " << step;
        if (!there) continue;
        ASSERT_EQ(found->FileName, wanted);
        ASSERT_EQ(&list.At(list.PositionOf(*found)), found);
    }
}
