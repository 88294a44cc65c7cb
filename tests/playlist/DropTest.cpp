#include "tests/HandClock.h"
#include "tests/playlist/Playing.h"

using namespace Qt::StringLiterals;

class DropTest : public PlayingTest {};

TEST_F(DropTest, FilesFoldersAndListsBecomeEntriesWithWhatIsKnownOfThem) {
    Add(u"ab"_s);
    folder_.Add(u"sub/deep/Zoe - Beta.wav"_s, 3);
    folder_.Add(u"sub/Anna - Alpha.wav"_s, 2);
    Put(u"sub/cover.jpg"_s, "no song");
    const QString module = Put(u"tune.mod"_s, "module");
    const QString list = Put(u"list.m3u"_s, "#EXTM3U\r\n" + Path(u"a"_s).toStdString() + "\r\n/gone.mp3\r\n");
    EXPECT_EQ(list_.InsertFiles(1, {folder_.Path(u"sub/../sub"_s), u"/not/there.mp3"_s, module, list}), 5);
    EXPECT_EQ(Listed(), u"aAnna - AlphaZoe - Betatuneagoneb"_s);
    EXPECT_EQ(list_.Entry(1).Name, folder_.Path(u"sub/Anna - Alpha.wav"_s));
    EXPECT_EQ(list_.Entry(1).Record->Title, u"Alpha"_s);
    EXPECT_FALSE(list_.Entry(3).Record);
    EXPECT_FALSE(list_.Entry(5).Record);
    EXPECT_EQ(list_.TotalSeconds(), 5);
}

TEST_F(DropTest, TheDatabaseKnowsBetterThanTheFile) {
    TMusicDatabase database;
    list_.SetMusicDatabase(&database);
    TID3Tag song;
    song.Title = u"Aus der Sammlung"_s;
    database.AddEntry(folder_.Add(u"x.wav"_s), song);
    EXPECT_EQ(list_.InsertFiles(0, {Path(u"x"_s)}), 1);
    EXPECT_EQ(list_.Entry(0).Record->Title, u"Aus der Sammlung"_s);
}

TEST_F(DropTest, ADropThatTakesItsTimeIsALongOperationThatTheUserCanStop) {
    TMusicDatabase database;
    list_.SetMusicDatabase(&database);
    for (const QChar song : u"abcdefghijkl"_s)
        folder_.Add(u"sub/"_s + song + u".wav"_s, 1);
    HandClock clock;
    int starts = 0;
    int ends = 0;
    qint64 stopAt = -1;
    database.OnStartProgress = [&](TMusicDatabase&) { ++starts; };
    database.OnEndProgress = [&](TMusicDatabase&) { ++ends; };
    database.OnProgress = [&](TMusicDatabase& of, const ProgressPoint& point) {
        EXPECT_EQ(list_.Count(), 0);
        EXPECT_EQ(of.Caption(), u"MusicDatabase v6.0 - Nehme Songs in die PlayList auf"_s);
        if (point.Cur >= stopAt && stopAt >= 0) of.RequestAbort();
    };
    EXPECT_EQ(list_.InsertFiles(0, {folder_.Path(u"sub"_s)}), 12);
    EXPECT_EQ(starts, 0);  // at once, and nobody was told

    list_.Clear();
    clock.Step = 1000;
    EXPECT_EQ(list_.InsertFiles(0, {folder_.Path(u"sub"_s)}), 12);
    list_.Clear();
    stopAt = 5;
    EXPECT_EQ(list_.InsertFiles(0, {folder_.Path(u"sub"_s)}), 5);
    EXPECT_EQ(list_.TotalSeconds(), 5);
    list_.Clear();
    stopAt = 0;  // while the folder is searched
    EXPECT_EQ(list_.InsertFiles(0, {folder_.Path(u"sub"_s)}), 0);
    EXPECT_EQ(starts, 3);
    EXPECT_EQ(ends, 3);

    const ProgressRun other(database, u"x"_s);
    EXPECT_THROW(list_.InsertFiles(0, {folder_.Path(u"sub"_s)}), EAbort);
    EXPECT_EQ(Messages().size(), 1);
    EXPECT_EQ(list_.Count(), 0);
}
