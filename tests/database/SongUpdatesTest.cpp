#include "MusicManagment/database/songfiles/SongUpdates.h"

#include <gtest/gtest.h>

#include "MusicManagment/database/batches/FlagBatch.h"
#include "MusicManagment/database/batches/GenreAdaption.h"
#include "MusicManagment/database/batches/LengthBatch.h"
#include "MusicManagment/database/batches/TagBatch.h"
#include "MusicManagment/database/batches/TagsFromNames.h"
#include "MusicManagment/database/journal/Journal.h"
#include "tests/PrintQt.h"
#include "tests/ScriptedDialogs.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

namespace {

// Real files, their collection, and the journal in use.
class SongUpdatesTest : public testing::Test {
 protected:
    SongUpdatesTest() {
        // The desktop's bin of this user lies there.
        qputenv("XDG_DATA_HOME", QFile::encodeName(folder_.Path(u"data"_s)));
        QDir(folder_.Path()).mkdir(u"data"_s);
        SetJournal(&journal_);
        database_.SetAsynchronous(false);
        database_.SetModernTags(true);
        database_.SetRenameInPlace(true);
        database_.SetOrder({.SortType = stPath, .SubSortType = sstPath});
    }
    ~SongUpdatesTest() override {
        SetJournal(nullptr);
        qunsetenv("XDG_DATA_HOME");
    }

    SongHandle Add(const QString& name, quint8 mainGenre = 0) {
        SongOverrides overrides;
        overrides.MainGenre = mainGenre;
        return database_.Songs().HandleOf(database_.AddSong(folder_.Add(name, 2), overrides));
    }
    const TID3Tag& Song(SongHandle song) const { return *database_.Songs().Find(song); }
    SongUpdate Titled(SongHandle song, const QString& title) const {
        SongUpdate update{.Song = song, .Basis = Song(song), .Record = Song(song)};
        update.Record.Title = title;
        return update;
    }
    // What another program would find in the file.
    TID3Tag Reread(SongHandle song) const {
        return ReadSong(Song(song).FileName, database_.AudioReadOptions()).Tag;
    }

    SongFolder folder_;
    ScriptedDialogs dialogs_;
    Journal journal_{folder_.Path(u"journal.tsj"_s)};
    TMusicDatabase database_;
};

TEST_F(SongUpdatesTest, AnEditReachesFileRecordAndNameAndIsTakenBackAsAWhole) {
    const SongHandle a = Add(u"Queen - A.wav"_s);
    const SongHandle b = Add(u"Queen - B.wav"_s);
    const QByteArray before = folder_.Get(u"Queen - A.wav"_s);
    const BatchResult result =
        UpdateSongs(database_, u"2 Tags"_s, {Titled(a, u"X / ä"_s), Titled(b, u"Y"_s)}, Renaming::BySettings);
    EXPECT_EQ(result.Failed, QStringList());
    EXPECT_EQ(result.Changed, 2);
    EXPECT_EQ(result.Renamed, 2);
    EXPECT_EQ(Song(a).FileName, folder_.Path(u"Queen - X - ä.wav"_s));
    EXPECT_EQ(Reread(a).Title, u"X / ä"_s);
    EXPECT_TRUE(folder_.Get(u"Queen - X - ä.wav"_s).startsWith(before));  // the sound is as it was
    ASSERT_TRUE(journal_.ToUndo());
    EXPECT_EQ(journal_.ToUndo()->Caption, u"2 Tags"_s);
    EXPECT_EQ(journal_.Undo(&database_).Problems, QStringList());
    EXPECT_EQ(Song(a).Title, u"A"_s);
    EXPECT_EQ(folder_.Get(u"Queen - A.wav"_s), before);
    EXPECT_EQ(QDir(folder_.Path()).entryList({u"*.wav"_s}),
              (QStringList{u"Queen - A.wav"_s, u"Queen - B.wav"_s}));
    journal_.Redo(&database_);
    EXPECT_EQ(Song(b).FileName, folder_.Path(u"Queen - Y.wav"_s));
}

TEST_F(SongUpdatesTest, WhatIsInTheWayIsAskedAboutAfterTagAndRecordAreWritten) {
    const SongHandle a = Add(u"Queen - A.wav"_s);
    const SongHandle b = Add(u"Queen - B.wav"_s);
    const SongHandle c = Add(u"Queen - C.wav"_s);
    // Cancel ends the batch; what was done stays.
    BatchResult result =
        UpdateSongs(database_, u"2 Tags"_s, {Titled(a, u"B"_s), Titled(c, u"D"_s)}, Renaming::BySettings);
    EXPECT_TRUE(result.Stopped);
    EXPECT_EQ(dialogs_.Questions, QStringList{u"Die Datei Queen - B.wav existiert bereits."_s});
    EXPECT_EQ(dialogs_.Asked[0].Buttons,
              (QStringList{u"Ziel löschen"_s, u"Quelle löschen"_s, u"Abbrechen"_s}));
    EXPECT_EQ(Reread(a).Title, u"B"_s);
    EXPECT_EQ(Song(a).FileName, folder_.Path(u"Queen - A.wav"_s));
    EXPECT_EQ(Song(c).Title, u"C"_s);

    dialogs_.Answers = {1};  // the source goes
    result = UpdateSongs(database_, u"1 Tag"_s, {Titled(c, u"B"_s)}, Renaming::BySettings);
    EXPECT_FALSE(database_.Contains(folder_.Path(u"Queen - C.wav"_s)));
    EXPECT_TRUE(database_.Songs().Find(b) != nullptr && !result.Stopped);

    dialogs_.Answers = {0};  // the target goes
    result = UpdateSongs(database_, u"1 Tag"_s, {Titled(a, u"B"_s)}, Renaming::BySettings);
    EXPECT_EQ(result.Failed, QStringList());
    EXPECT_EQ(database_.Songs().Find(b), nullptr);
    EXPECT_EQ(Song(a).FileName, folder_.Path(u"Queen - B.wav"_s));

    folder_.Add(u"Queen - E.wav"_s);  // no song of the collection
    dialogs_.Answers = {0};
    result = UpdateSongs(database_, u"1 Tag"_s, {Titled(a, u"E"_s)}, Renaming::BySettings);
    ASSERT_EQ(result.Failed.size(), 1);
    EXPECT_TRUE(result.Failed[0].contains(u"Kann den Eintrag "_s) &&
                result.Failed[0].endsWith(u" nicht (mehr) finden."_s));
}

TEST_F(SongUpdatesTest, TwoSongsOfOneBatchDoNotTakeTheSameName) {
    const SongHandle a = Add(u"Queen - A.wav"_s);
    const SongHandle b = Add(u"Queen - B.wav"_s);
    const BatchResult result =
        UpdateSongs(database_, u"2 Tags"_s, {Titled(a, u"C"_s), Titled(b, u"C"_s)}, Renaming::BySettings);
    EXPECT_EQ(dialogs_.Questions.size(), 1);
    EXPECT_EQ(Song(a).FileName, folder_.Path(u"Queen - C.wav"_s));
    EXPECT_EQ(Song(b).FileName, folder_.Path(u"Queen - B.wav"_s));
    EXPECT_TRUE(result.Stopped);
}

TEST_F(SongUpdatesTest, WhatChangedMeanwhileStaysBesideAnEdit) {
    const SongHandle a = Add(u"Queen - A.wav"_s);
    const SongUpdate edit = Titled(a, u"X"_s);
    TID3Tag played = Song(a);
    played.PlayCount = 3;
    database_.UpdateEntry(database_.Songs().PositionOf(a), played);
    UpdateSongs(database_, u"1 Tag"_s, {edit}, Renaming::Never);
    EXPECT_TRUE(Song(a).Title == u"X"_s && Song(a).PlayCount == 3);
    EXPECT_EQ(Reread(a).PlayCount, 3u);
    const SongIndex place =
        UpdateSongEntry(database_, database_.Songs().PositionOf(a), Titled(a, u"Y"_s).Record, true);
    EXPECT_EQ(database_.Song(place).FileName, folder_.Path(u"Queen - Y.wav"_s));
}

TEST_F(SongUpdatesTest, AFileThatCannotBeWrittenKeepsItsRecordAndTheOthersGoOn) {
    const SongHandle a = Add(u"Queen - A.wav"_s);
    const SongHandle b = Add(u"Queen - B.wav"_s);
    QFile::remove(Song(a).FileName);
    const BatchResult result =
        UpdateSongs(database_, u"2 Tags"_s, {Titled(a, u"X"_s), Titled(b, u"Y"_s)}, Renaming::Never);
    ASSERT_EQ(result.Failed.size(), 1);
    EXPECT_TRUE(result.Failed[0].startsWith(Song(a).FileName));
    EXPECT_EQ(Song(a).Title, u"A"_s);
    EXPECT_EQ(Reread(b).Title, u"Y"_s);
}

TEST_F(SongUpdatesTest, FlagsAreWrittenOnceAndTagsAreRemovedAndReadAgain) {
    const SongHandle a = Add(u"Queen - A.wav"_s, 8);
    const BatchSongs all = AllSongs(database_);
    EXPECT_EQ(ChangeFlag(database_, all, sfBurned, FlagChange::Set).Changed, 1);
    const QByteArray flagged = folder_.Get(u"Queen - A.wav"_s);
    EXPECT_EQ(ChangeFlag(database_, all, sfBurned, FlagChange::Set).Changed, 0);
    EXPECT_EQ(folder_.Get(u"Queen - A.wav"_s), flagged);
    EXPECT_EQ(Reread(a).Flags, sfBurned);
    UpdateSongs(database_, u"1 Tag"_s, {Titled(a, u"Z"_s)}, Renaming::Never);
    EXPECT_EQ(RemoveTags(database_, all).Changed, 1);
    EXPECT_EQ(Song(a).Title, u"A"_s);  // of the file's name
    EXPECT_EQ(Song(a).Flags, sfBurned);
    EXPECT_EQ(Song(a).MainGenre, 8);
    journal_.Undo(&database_);
    TID3Tag record = Song(a);
    record.Title = u"only here"_s;
    record.PlayCount = 7;
    database_.UpdateEntry(database_.Songs().PositionOf(a), record);
    EXPECT_EQ(RereadTags(database_, all).Changed, 1);
    EXPECT_EQ(Song(a).Title, u"Z"_s);
    EXPECT_EQ(Song(a).PlayCount, 7u);
}

TEST_F(SongUpdatesTest, TagsFromNamesLeaveTheNamesAndAreTakenBackTogether) {
    const SongHandle a = Add(u"1999/07 A.wav"_s);
    Add(u"1999/B.wav"_s);
    const QByteArray before = folder_.Get(u"1999/07 A.wav"_s);
    const BatchResult result =
        TakeTagsFromNames(database_, AllSongs(database_), NameMatcher(u"%YEAR%/%TRACKNR% %TITLE%"_s));
    EXPECT_EQ(result.Changed, 1);
    EXPECT_EQ(result.Renamed, 0) << "although the settings rename what changes";
    const TID3Tag written = Reread(a);
    EXPECT_EQ(written.Title + written.Year + QString::number(written.Track), u"A19997"_s);
    EXPECT_EQ(journal_.ToUndo()->Caption, u"Tags aus Dateinamen (1 Song)"_s);
    journal_.Undo(&database_);
    EXPECT_EQ(folder_.Get(u"1999/07 A.wav"_s), before);
}

TEST_F(SongUpdatesTest, GenresAreAdaptedFromTheSameArtistOrAsked) {
    Add(u"Queen - A.wav"_s, 8);
    const SongHandle b = Add(u"QUEEN - B.wav"_s);
    const SongHandle c = Add(u"Queeen - C.wav"_s);
    const SongHandle d = Add(u"Queeen - D.wav"_s);
    const SongHandle e = Add(u"Zz - E.wav"_s);
    database_.SetRenameAndMoveMP3s(false);
    AdaptGenres(database_, AllSongs(database_));
    EXPECT_EQ(Song(b).MainGenre, 8);
    EXPECT_EQ(Reread(b).Artist, u"Queen"_s);
    EXPECT_EQ(dialogs_.Questions.size(), 2);  // a question a song
    EXPECT_EQ(dialogs_.Questions[0],
              u"Soll für Queeen der Artist Queen verwendet werden (83% Übereinstimmung)"_s);
    EXPECT_EQ(dialogs_.Messages.size(), 3);
    EXPECT_EQ(dialogs_.Messages[2], u"Kann kein passendes Genre für den Song Zz - E finden."_s);

    database_.SetQuietBatches(true);
    dialogs_.Answers = {0};
    const GenreAdaption quiet = AdaptGenres(database_, AllSongs(database_));
    EXPECT_EQ(dialogs_.Questions.size(), 3);  // one an artist
    EXPECT_TRUE(Song(c).MainGenre == 8 && Song(d).MainGenre == 8 && Song(e).MainGenre == 0);
    EXPECT_EQ(quiet.WithoutGenre, QStringList{u"Zz - E"_s});
    EXPECT_EQ(dialogs_.Messages.size(), 3);
}

TEST_F(SongUpdatesTest, ALengthIsEnteredAsMinutesOrSeconds) {
    EXPECT_EQ(ParseLength(u"4:05"_s), 245);
    EXPECT_EQ(ParseLength(u" 1:02:03 "_s), 3723);
    EXPECT_EQ(ParseLength(u"245"_s), 245);
    for (const QString& bad : {u""_s, u"4:60"_s, u"-1"_s, u"1:2:3:4"_s, u"70000"_s, u"a"_s})
        EXPECT_EQ(ParseLength(bad), std::nullopt) << bad.toStdString();
    const SongHandle a = Add(u"Queen - A.wav"_s);
    dialogs_.Inputs = {u"1:30"_s};
    EnterLength(database_, a);
    EXPECT_TRUE(Song(a).Length == 90 && Song(a).Flags == sfLengthCorrect);
    EXPECT_EQ(VerifyLengths(database_, AllSongs(database_)).Updates.Changed, 1);
    EXPECT_EQ(Song(a).Length, 2);  // what the file really holds
}

TEST_F(SongUpdatesTest, ASongThatStandsForOthersTakesTheirPlaysAndAllOfItIsTakenBackAsOne) {
    const auto addPlayed = [this](const QString& name, quint32 plays) {
        const SongHandle song = Add(name);
        TID3Tag played = Song(song);
        played.PlayCount = plays;
        database_.UpdateEntry(database_.Songs().PositionOf(song), played);
        return song;
    };
    const SongHandle kept = addPlayed(u"Queen - A.wav"_s, 2);
    const SongHandle b = addPlayed(u"Queen - A (b).wav"_s, 3);
    const SongHandle c = addPlayed(u"Queen - A (c).wav"_s, 4);
    const SongHandle lost = addPlayed(u"Queen - Lost.wav"_s, 8);
    QFile::remove(Song(lost).FileName);
    QFile::link(Song(kept).FileName, folder_.Path(u"Queen - Link.wav"_s));
    const SongHandle link =
        database_.Songs().HandleOf(database_.AddSong(folder_.Path(u"Queen - Link.wav"_s)));
    const QString keptPath = Song(kept).FileName;
    const QString bPath = Song(b).FileName;
    PathChanges told;
    const Subscription listener =
        database_.Events().Superseded.Subscribe([&](const PathChanges& changes) { told = changes; });
    EXPECT_EQ(ReplaceSongs(database_, u"1 doppelter Eintrag"_s, {{lost, kept}}).Failed.size(), 1);
    EXPECT_TRUE(database_.Count() == 5 && QFile::exists(keptPath)) << "the only one with a file";
    // The last two are passed over: b goes itself, and a song that stays for others stays.
    const BatchResult result = ReplaceSongs(database_, u"3 doppelte Einträge"_s,
                                            {{kept, b}, {kept, c}, {kept, link}, {b, lost}, {c, kept}});
    EXPECT_EQ(result.Failed, QStringList());
    EXPECT_EQ(database_.Count(), 2);
    EXPECT_EQ(Song(kept).PlayCount, 9u);
    EXPECT_TRUE(told.size() == 3 && told.value(bPath) == keptPath);
    EXPECT_FALSE(QFile::exists(bPath));
    EXPECT_TRUE(QFile::exists(folder_.Path(u"Queen - Link.wav"_s))) << "another name of the kept file";
    EXPECT_EQ(journal_.Undo(&database_).Problems, QStringList());
    EXPECT_EQ(Song(kept).PlayCount, 2u);
    EXPECT_EQ(database_.Songs().Find(bPath)->PlayCount, 3u);
    EXPECT_TRUE(QFile::exists(bPath) && database_.Count() == 5);
}

TEST_F(SongUpdatesTest, LengthsAreAskedForUntilNobodyIsThereToAsk) {
    const SongHandle a = Add(u"Queen - A.wav"_s);
    const SongHandle b = Add(u"Queen - B.wav"_s);
    database_.SetUseWinAmpForLenCheck(true);
    std::function<void()> refuse = [] { throw ERukException(u"keine Länge"_s); };
    database_.OnMeasureLength = [&](const QString& path) -> quint32 {
        if (path == Song(b).FileName) refuse();
        return 61'999;
    };
    LengthBatchResult result = VerifyLengths(database_, AllSongs(database_));
    EXPECT_TRUE(Song(a).Length == 61 && Song(a).Flags == sfLengthCorrect && Song(b).Flags == 0);
    EXPECT_EQ(result.Updates.Failed, QStringList{Song(b).FileName + u": keine Länge"_s});
    EXPECT_EQ(result.Remark, QString());

    refuse = [] { throw ENoLengthMeasure(u"Niemand da."_s); };
    result = VerifyLengths(database_, AllSongs(database_));
    EXPECT_TRUE(Song(a).Length == 2 && Song(b).Length == 2 && Song(b).Flags == sfLengthCorrect);
    EXPECT_EQ(result.Updates.Failed, QStringList());
    EXPECT_TRUE(result.Remark.endsWith(u"Niemand da."_s));
}

TEST(BatchSongs, ASingleMarkMeansTheSelectedSong) {
    const SongHandle marked{1, 1};
    const SongHandle selected{2, 1};
    EXPECT_EQ(MarkedSongs({{marked}, selected}).Songs, std::vector{selected});
    EXPECT_EQ(MarkedSongs({{marked, selected}, marked}).Songs, (std::vector{marked, selected}));
    const BatchSongs many = MarkedSongs({std::vector(kMostMarks + 3, marked), selected});
    EXPECT_TRUE(many.Songs.size() == kMostMarks && many.Passed == 3);
}

}  // namespace
