#include "MusicManagment/database/intake/FolderWalk.h"

#include <gtest/gtest.h>

#include "MusicManagment/database/intake/Intake.h"
#include "tests/PrintQt.h"
#include "tests/database/SongFolder.h"

#ifndef Q_OS_WIN
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>
#endif

using namespace Qt::StringLiterals;

namespace {

struct Walked {
    QStringList Files;
    QStringList Unreadable;
};

Walked WalkAll(const QString& folder, bool withSubfolders = true) {
    FolderWalk walk({.WithSubfolders = withSubfolders, .IsWanted = &IsSongFile});
    Walked result;
    EXPECT_TRUE(walk.Walk(folder, result.Files));
    result.Unreadable = walk.Unreadable();
    return result;
}

// How often the walk asks whether to go on; it is told to stop at the question with this number.
int QuestionsUntilStopped(const QString& folder, int stopAt, QStringList& files) {
    int questions = 0;
    FolderWalk walk(
        {.IsWanted = &IsSongFile, .Progress = [&](const QString&) { return ++questions == stopAt; }});
    EXPECT_EQ(walk.Walk(folder, files), stopAt < 0);
    return questions;
}

}  // namespace

TEST(FolderWalkTest, FilesComeByNameBeforeThoseOfSubfolders) {
    const SongFolder songs;
    songs.Add({u"b/z.wav"_s, u"b/a/1.wav"_s, u"a/2.wav"_s, u"c.wav"_s, u"B.MP3"_s, u"a.wma"_s, u".x/y.mp2"_s,
               u"cover.jpg"_s, u"d.ogg"_s, u"mp3"_s, u"wav."_s});
    EXPECT_EQ(WalkAll(songs.Path()).Files, songs.Paths({u"B.MP3"_s, u"a.wma"_s, u"c.wav"_s, u".x/y.mp2"_s,
                                                        u"a/2.wav"_s, u"b/z.wav"_s, u"b/a/1.wav"_s}));
    EXPECT_EQ(WalkAll(songs.Path(), false).Files, songs.Paths({u"B.MP3"_s, u"a.wma"_s, u"c.wav"_s}));
    EXPECT_TRUE(WalkAll(songs.Path()).Unreadable.isEmpty());
    const Walked walked = WalkAll(songs.Path(u"none"_s));
    EXPECT_TRUE(walked.Files.isEmpty());
    ASSERT_EQ(walked.Unreadable.size(), 1);
    EXPECT_TRUE(walked.Unreadable[0].startsWith(u"Kann den Ordner nicht öffnen: "_s + songs.Path(u"none"_s)));
}

TEST(FolderWalkTest, EachFolderAndEveryFewHundredEntriesTheWalkCanBeStopped) {
    const SongFolder songs;
    songs.Add({u"a/1.wav"_s, u"b/2.wav"_s, u"c/3.wav"_s});
    QStringList files;
    EXPECT_EQ(QuestionsUntilStopped(songs.Path(), -1, files), 4);
    EXPECT_EQ(files.size(), 3);
    files.clear();
    EXPECT_EQ(QuestionsUntilStopped(songs.Path(), 3, files), 3);
    EXPECT_EQ(files, songs.Paths({u"a/1.wav"_s}));

    const SongFolder large;
    for (int i = 0; i < 300; ++i)
        large.Add(QString::number(i) + u".wav"_s);
    files.clear();
    QuestionsUntilStopped(large.Path(), 2, files);
    EXPECT_GT(files.size(), 0) << "what was found so far is kept";
    EXPECT_LT(files.size(), 300);
}

TEST(FolderWalkTest, RecycleBinsAndFoldersOfTheSystemAreEnteredOnlyOnRequest) {
    const SongFolder songs;
    songs.Add({u".Trash/1000/1.wav"_s, u".Trash-1000/files/1.wav"_s, u"$Recycle.Bin/S-1/1.wav"_s,
               u"System Volume Information/1.wav"_s, u"lost+found/1.wav"_s, u"Tunestead Recycle-Bin/1.wav"_s,
               u".local/share/Trash/files/1.wav"_s, u"Trash/A - 2.wav"_s, u".Trashcan Sinatras/A - 3.wav"_s});
    EXPECT_EQ(WalkAll(songs.Path()).Files,
              songs.Paths({u".Trashcan Sinatras/A - 3.wav"_s, u"Trash/A - 2.wav"_s}));
    EXPECT_EQ(WalkAll(songs.Path(u"Tunestead Recycle-Bin"_s)).Files,
              songs.Paths({u"Tunestead Recycle-Bin/1.wav"_s}));
}

#ifndef Q_OS_WIN

TEST(FolderWalkTest, LinksToFoldersDoNotLoopAndLinksToFilesKeepTheirName) {
    const SongFolder songs;
    songs.Add({u"a/1.wav"_s, u"b/2.wav"_s});
    QFile::link(songs.Path(), songs.Path(u"a/up"_s));
    QFile::link(u"."_s, songs.Path(u"a/self"_s));
    QFile::link(songs.Path(u"b"_s), songs.Path(u"a/same as b"_s));
    QFile::link(songs.Path(u"a/1.wav"_s), songs.Path(u"z.wav"_s));
    const Walked walked = WalkAll(songs.Path());
    EXPECT_EQ(walked.Files, songs.Paths({u"z.wav"_s, u"a/1.wav"_s, u"a/same as b/2.wav"_s}));
    EXPECT_TRUE(walked.Unreadable.isEmpty());
}

TEST(FolderWalkTest, WhatIsNoFileIsNamedOnlyWhenItLooksLikeASong) {
    const SongFolder songs;
    songs.Add(u"1.wav"_s);
    QDir(songs.Path()).mkdir(u"folder.mp3"_s);
    ASSERT_EQ(::mkfifo(QFile::encodeName(songs.Path(u"pipe.mp3"_s)).constData(), 0600), 0);
    ASSERT_EQ(::mkfifo(QFile::encodeName(songs.Path(u"pipe"_s)).constData(), 0600), 0);
    QFile::link(u"gone"_s, songs.Path(u"dangling.wav"_s));
    QFile::link(u"round"_s, songs.Path(u"round"_s));
    Walked walked = WalkAll(songs.Path());
    EXPECT_EQ(walked.Files, songs.Paths({u"1.wav"_s}));
    walked.Unreadable.sort();
    EXPECT_EQ(walked.Unreadable, (QStringList{u"Keine gewöhnliche Datei: "_s + songs.Path(u"dangling.wav"_s),
                                              u"Keine gewöhnliche Datei: "_s + songs.Path(u"pipe.mp3"_s)}));
}

TEST(FolderWalkTest, NamesThatAreNoTextAreShownWithTheirBytes) {
    const SongFolder songs;
    songs.Add(u"ä.wav"_s);
    const QByteArray root = QFile::encodeName(songs.Path()) + '/';
    for (const char* name : {"b\xE4r \xC3\xA4.mp3", "n\xFFte.txt"})
        ::close(::open((root + name).constData(), O_CREAT | O_WRONLY, 0600));
    ASSERT_EQ(::mkdir((root + "M\xFCsik").constData(), 0700), 0);
    Walked walked = WalkAll(songs.Path());
    EXPECT_EQ(walked.Files, songs.Paths({u"ä.wav"_s}));
    walked.Unreadable.sort();
    EXPECT_EQ(walked.Unreadable, (QStringList{u"Ungültiger Dateiname: "_s + songs.Path(u"b\\xE4r ä.mp3"_s),
                                              u"Ungültiger Ordnername: "_s + songs.Path(u"M\\xFCsik"_s)}));
}

#endif
