#include "tests/ScriptedVolumes.h"
#include "tests/playlist/Playing.h"

using namespace Qt::StringLiterals;

// Which song is played next, and what becomes of songs that cannot be played.

namespace {

const QString kAllPlayed = u"Es wurden alle in der PlayList enthaltenen Lieder abgespielt."_s;
const QString kNothingPlayable = u"Keines der Lieder in der PlayList konnte abgespielt werden."_s;

class NextTest : public PlayingTest {};

}  // namespace

TEST_F(NextTest, DownAndUpPlayEachSongOnceFromWhereTheUserBegan) {
    Add(u"abcd"_s);
    list_.SetPlayOrder(poUpwards);
    EXPECT_EQ(PlayOn(), u"dcba"_s);
    list_.SetPlayOrder(poDownwards);
    list_.StartNewRound();
    EXPECT_EQ(PlayOn(), u"bcda"_s);
    EXPECT_EQ(Messages(), (QStringList{kAllPlayed, kAllPlayed}));

    list_.PlayEntry(2);  // chosen after the last of a round it begins the next
    EXPECT_EQ(PlayOn(), u"dab"_s);

    list_.SetPlayOrder(poUpwards);
    list_.StartNewRound();
    list_.PlayEntry(1);
    EXPECT_EQ(PlayOn(), u"adc"_s);
    EXPECT_EQ(Names(list_.History()), u"cdab"_s);
    EXPECT_EQ(Current(), u"c"_s);
}

TEST_F(NextTest, RandomPlaysEachSongOnceARound) {
    Add(u"abc"_s);
    list_.SetPlayOrder(poRandom);
    QSet<QString> sequences;
    for (unsigned seed = 0; seed < 60; ++seed) {
        list_.SetRandom(std::mt19937(seed));
        list_.StartNewRound();
        const QString played = PlayOn();
        ASSERT_EQ(played.size(), 3);
        sequences << played;
    }
    EXPECT_EQ(sequences.size(), 6);
    EXPECT_EQ(Messages(), QStringList(60, kAllPlayed));
}

TEST_F(NextTest, RepeatAllGoesRoundWithoutAWord) {
    Add(u"abc"_s);
    list_.SetRepeatAll(true);
    EXPECT_EQ(PlayOn(7), u"abcabca"_s);
    EXPECT_TRUE(Messages().isEmpty());
    while (list_.Count() > 1)
        list_.Remove(1);
    EXPECT_EQ(PlayOn(3), u"aaa"_s);  // a list of one song repeats it
}

TEST_F(NextTest, StopAfterPlayPlaysNothingNotEvenTheQueue) {
    Add(u"ab"_s);
    list_.Enqueue(1);
    list_.SetPlayOrder(poStopAfterPlay);
    EXPECT_FALSE(list_.HasNext());
    EXPECT_FALSE(list_.PlayNext());
    EXPECT_EQ(list_.Queue().size(), 1);
}

TEST_F(NextTest, TheQueueComesFirstAndThenTheOrderGoesOnFromThere) {
    Add(u"abcdE"_s);
    list_.PlayEntry(0);
    for (const int index : {4, 2, 4, 9, 1, -1})
        list_.Enqueue(index);
    EXPECT_EQ(PlayOn(), u"cbd"_s);  // E has no file, and after b the next is d
    EXPECT_TRUE(list_.Queue().isEmpty());
}

TEST_F(NextTest, AskingForANextSongChangesAndSaysNothing) {
    EXPECT_FALSE(list_.HasNext());
    Add(u"ab"_s);
    EXPECT_TRUE(list_.HasNext());
    PlayOn();
    dialogs_.Messages.clear();
    EXPECT_FALSE(list_.HasNext());
    list_.SetRepeatAll(true);
    EXPECT_TRUE(list_.HasNext());
    list_.SetRepeatAll(false);
    list_.Enqueue(0);
    EXPECT_TRUE(list_.HasNext());
    EXPECT_EQ(list_.Queue().size(), 1);
    EXPECT_EQ(list_.History().size(), 2);
    EXPECT_TRUE(Messages().isEmpty());
}

TEST_F(NextTest, AnEmptyListIsToldAndSoIsAMissingPlayer) {
    EXPECT_FALSE(list_.PlayNext());
    EXPECT_EQ(Messages(), QStringList{u"Keine Lieder in der PlayList zum Abspielen"_s});
    Add(u"a"_s);
    list_.SetPlaySound(nullptr);
    EXPECT_THROW(list_.PlayNext(), EPlayListException);
    EXPECT_THROW(list_.PlayEntry(0), EPlayListException);
}

TEST_F(NextTest, WhoHandlesTheEndOfARoundDecidesWhetherTheUserIsTold) {
    TMusicDatabase database;
    list_.SetMusicDatabase(&database);
    Add(u"a"_s);
    bool tell = false;
    int asked = 0;
    list_.OnAllFilesPlayed = [&](TPlayList&, bool& showException) {
        EXPECT_FALSE(showException);
        showException = tell;
        ++asked;
    };
    PlayOn();
    EXPECT_TRUE(Messages().isEmpty());
    tell = true;
    list_.PlayNext();
    EXPECT_EQ(Messages(), QStringList{kAllPlayed});
    database.OnAllFilesPlayed = [](TMusicDatabase&, bool& showException) { showException = false; };
    list_.PlayNext();
    EXPECT_EQ(asked, 3);
    EXPECT_EQ(Messages().size(), 1);
}

TEST_F(NextTest, PreviousGoesBackAndNextReturns) {
    Add(u"abcd"_s);
    list_.PlayEntry(0);
    EXPECT_FALSE(list_.HasPrevious());
    EXPECT_FALSE(list_.PlayPrevious());
    list_.PlayNext();
    list_.PlayNext();
    player_.Played.clear();
    EXPECT_TRUE(list_.PlayPrevious());
    EXPECT_TRUE(list_.PlayPrevious());
    EXPECT_FALSE(list_.PlayPrevious());
    EXPECT_EQ(player_.Played.join(QString()), u"ba"_s);
    EXPECT_EQ(Names(list_.History()), u"a"_s);
    EXPECT_EQ(PlayOn(), u"bcd"_s);
}

TEST_F(NextTest, PreviousPassesOverWhatIsGone) {
    Add(u"abcd"_s);
    PlayOn(4);
    QFile::remove(Path(u"c"_s));
    list_.Remove(1);
    EXPECT_TRUE(list_.PlayPrevious());
    EXPECT_EQ(Current(), u"a"_s);
    EXPECT_EQ(Names(list_.Queue()), u"d"_s);

    list_.StartNewRound();
    PlayOn(2);
    const QStringList history = list_.History();
    list_.Remove(2);  // d, which was played before
    EXPECT_FALSE(list_.PlayPrevious());
    EXPECT_EQ(list_.History(), history);
}

TEST_F(NextTest, ASongThatIsListedTwiceIsPlayedWhereItWasChosen) {
    Add(u"abac"_s);
    list_.PlayEntry(2);
    EXPECT_EQ(list_.IndexOf(), 2);
    list_.Move({3}, 0);
    EXPECT_EQ(list_.IndexOf(), 3);
    list_.Enqueue(1);  // the other a
    EXPECT_EQ(list_.QueuePosition(3), -1);
    list_.PlayNext();
    EXPECT_EQ(list_.IndexOf(), 1);
    EXPECT_EQ(PlayOn(), u"bc"_s);

    list_.PlayEntry(3);
    list_.PlayNext();
    list_.PlayPrevious();
    EXPECT_EQ(list_.IndexOf(), 3);
    list_.Remove(3);  // the first with its name stands in for an entry that has gone
    EXPECT_EQ(list_.IndexOf(), 1);
}

TEST_F(NextTest, TheEndOfARoundIsToldOnceAndAtTheEndOfItsLastSong) {
    Add(u"abC"_s);
    list_.PlayEntry(0);
    list_.PlayNext();
    player_.Broken = {u"d"_s};
    Add(u"d"_s);
    EXPECT_TRUE(list_.HasNext());
    EXPECT_FALSE(list_.PlayNext(SongChange::CrossFadeOnly));
    EXPECT_TRUE(Messages().isEmpty());
    EXPECT_EQ(Current(), u"b"_s);
    EXPECT_FALSE(list_.PlayNext());
    EXPECT_EQ(Messages(), (QStringList{kAllPlayed, u"Engine: d\r\n"_s + Path(u"d"_s)}));
}

TEST_F(NextTest, OneBadFileNeitherEndsTheRoundNorIsToldTwice) {
    Add(u"abcd"_s);
    player_.Broken = {u"b"_s, u"c"_s};
    EXPECT_EQ(PlayOn(), u"ad"_s);
    ASSERT_EQ(Messages().size(), 2);
    EXPECT_EQ(dialogs_.MessageKinds[0], MessageKind::Error);
    EXPECT_EQ(Messages()[0], u"Engine: b\r\n"_s + Path(u"b"_s) + u"\r\n\r\nEngine: c\r\n"_s + Path(u"c"_s));
    EXPECT_EQ(Messages()[1], kAllPlayed);
    EXPECT_EQ(Names(list_.History()), u"da"_s);
}

TEST_F(NextTest, NothingPlayableStopsInEveryOrder) {
    Add(u"abcdefgH"_s);
    for (const QChar song : u"abcdefg"_s)
        player_.Broken << song;
    for (const TPlayOrder order : {poDownwards, poUpwards, poRandom})
        for (const bool repeat : {false, true}) {
            dialogs_.Messages.clear();
            list_.StartNewRound();
            list_.SetPlayOrder(order);
            list_.SetRepeatAll(repeat);
            list_.Enqueue(7);
            list_.Enqueue(0);
            EXPECT_FALSE(list_.PlayNext());
            EXPECT_TRUE(list_.Queue().isEmpty());
            EXPECT_EQ(Messages().first().startsWith(repeat ? kNothingPlayable : kAllPlayed), true);
            EXPECT_TRUE(Messages().last().endsWith(u"und 2 weitere"_s)) << Messages().last().toStdString();
        }
}

TEST_F(NextTest, AnEntryThatTheUserChoseThrowsWhatTheEngineThrows) {
    Add(u"abC"_s);
    player_.Broken = {u"b"_s};
    list_.PlayEntry(0);
    EXPECT_THROW(list_.PlayEntry(1), EEngine);
    EXPECT_EQ(Names(list_.History()), u"a"_s);
    EXPECT_FALSE(list_.PlayEntry(2));
    EXPECT_EQ(Current(), u"b"_s);  // where the order goes on
}

TEST_F(NextTest, ACrossFadeFallsBackOnlyWhenItMay) {
    Add(u"abc"_s);
    list_.PlayEntry(0);
    EXPECT_TRUE(list_.PlayNext(SongChange::CrossFade));
    EXPECT_EQ(player_.Faded, QStringList{u"b"_s});
    player_.CanFade = false;
    list_.Enqueue(0);
    EXPECT_TRUE(list_.PlayNext(SongChange::CrossFadeOnly));  // b plays on, and a is still to come
    EXPECT_EQ(Current(), u"b"_s);
    EXPECT_EQ(Names(list_.Queue()), u"a"_s);
    EXPECT_EQ(Names(list_.History()), u"ba"_s);
    EXPECT_TRUE(list_.PlayNext(SongChange::CrossFade));
    EXPECT_EQ(player_.Played, (QStringList{u"a"_s, u"a"_s}));
    EXPECT_EQ(player_.Plays, 2);
    player_.PlaysAtOnce = true;
    list_.PlayNext();
    EXPECT_EQ(player_.Plays, 2);
}

TEST_F(NextTest, ATimerThatFiresWhileAFileIsOpenedStartsNoSecondSearch) {
    Add(u"abc"_s);
    player_.OnOpen = [this] {
        EXPECT_FALSE(list_.PlayNext());
        EXPECT_FALSE(list_.PlayPrevious());
        list_.Clear();
    };
    EXPECT_TRUE(list_.PlayNext());
    EXPECT_EQ(player_.Played, QStringList{u"a"_s});
}

TEST_F(NextTest, PlayingReadsTheRecordAnew) {
    TMusicDatabase database;
    list_.SetMusicDatabase(&database);
    Add(u"ab"_s);
    TID3Tag song;
    song.Title = u"Neu"_s;
    song.Length = 90;
    database.AddEntry(Path(u"a"_s), song);
    list_.PlayEntry(0, {.DatabaseHint = 0});
    ASSERT_TRUE(list_.Entry(0).Record);
    EXPECT_EQ(list_.Entry(0).Record->Title, u"Neu"_s);
    EXPECT_EQ(list_.TotalSeconds(), 90);
    list_.PlayEntry(1, {.DatabaseHint = 0});  // the hint leads to another song
    EXPECT_EQ(list_.Entry(1).Record->FileName, Path(u"b"_s));
    EXPECT_EQ(list_.Entry(1).Record->MPEGLayer, u"Wave"_s);
}

TEST_F(NextTest, ASongOnACdIsPlayedFromWhereTheDatabaseFindsIt) {
    TMusicDatabase database;
    list_.SetMusicDatabase(&database);
    const QString onCd = u":1A2B3C4D:\\x.wav"_s;
    ScriptedVolumes volumes;
    list_.Insert(0, {.Name = onCd});
    EXPECT_FALSE(list_.PlayEntry(0));
    folder_.Add(u"x.wav"_s);
    volumes.Mount(folder_.Path(), 0x1A2B3C4D, {}, 0);
    EXPECT_TRUE(list_.PlayEntry(0));
    EXPECT_EQ(list_.CurrentSong(), onCd);
    EXPECT_EQ(list_.CurrentFile(), Path(u"x"_s));
    volumes.Unmount();
    EXPECT_EQ(list_.RemoveUnavailable(), 1);  // which asks nobody for a medium
}
