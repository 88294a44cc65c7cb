#include "MusicManagment/database/songfiles/NamePattern.h"

#include <gtest/gtest.h>

#include "MusicManagment/database/songfiles/RenameTarget.h"

#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

TID3Tag Song() {
    TID3Tag song;
    song.Title = u"Was ist?"_s;
    song.Artist = u"AC/DC"_s;
    song.Album = u"LP"_s;
    song.Length = 45;
    song.MainGenre = 8;
    song.Track = 7;
    return song;
}

}  // namespace

TEST(NamePattern, FolderAndExtensionAreKept) {
    EXPECT_EQ(BuildNameFromPattern(u"%ARTIST% - %TITLE%"_s, u"/a.b/x.MP3"_s, Song()),
              u"/a.b/AC-DC - Was ist_.MP3"_s);
    EXPECT_EQ(BuildNameFromPattern(u"%TRACKNR% %LENGTHV% %LENGTHF%"_s, u"x"_s, Song()), u"7 45 s 0-45"_s);
    EXPECT_EQ(BuildNameFromPattern(u"%MAINGENRE%|%ID3GENRE%"_s, u"x.mp3"_s, Song()),
              u"Rock-Pop-Undefiniert.mp3"_s);
}

TEST(NamePattern, ValuesAreExpandedOneAfterTheOther) {
    TID3Tag song = Song();
    song.Title = u"%ALBUM%"_s;
    song.Album = u"%TITLE%"_s;
    EXPECT_EQ(BuildNameFromPattern(u"%TITLE%"_s, u"x.mp3"_s, song), u"%TITLE%.mp3"_s);
    song.Artist.clear();
    EXPECT_EQ(BuildNameFromPattern(u"%ARTIST% - x"_s, u"x.mp3"_s, song), u" - x.mp3"_s);
}

TEST(NamePattern, ALongNameLosesTheEndOfItsTitle) {
    TID3Tag song = Song();
    song.Title = QString(300, u'ä');  // two bytes each
    const QString name = BuildNameFromPattern(u"%TITLE% - %ARTIST%"_s, u"/m/x.mp3"_s, song).mid(3);
    EXPECT_EQ(name.toUtf8().size(), 254);
    EXPECT_TRUE(name.startsWith(u"ää"_s) && name.endsWith(u"ä - AC-DC.mp3"_s));
    song.Album = u"👩‍👩‍👧"_s.repeated(30);  // one character of 18 bytes each
    const QString album = BuildNameFromPattern(u"%ALBUM%"_s, u"x.mp3"_s, song);
    EXPECT_EQ(album, u"👩‍👩‍👧"_s.repeated(13) + u".mp3"_s);
}

TEST(RenameTarget, FollowsTheSettings) {
    TMusicDatabase database;
    database.SetMP3MoveRootDir(u"/stamm"_s);
    const TID3Tag song = Song();
    const auto target = [&](const TID3Tag& info) { return RenameTarget(database, u"/old/x.mp3"_s, info); };
    EXPECT_EQ(target(song), u"/stamm/old/AC-DC - Was ist_.mp3"_s);  // the old folder goes on below the root
    database.SetRenameInPlace(true);
    EXPECT_EQ(target(song), u"/old/AC-DC - Was ist_.mp3"_s);
    database.SetMoveMP3sAfterGenreChange(true);
    EXPECT_EQ(target(song), u"/stamm/Rock, Pop/AC-DC - Was ist_.mp3"_s);
    TID3Tag unsorted = song;
    unsorted.MainGenre = 0;
    EXPECT_EQ(target(unsorted), u"/old/AC-DC - Was ist_.mp3"_s);
    database.SetRenameAndMoveMP3s(false);
    EXPECT_EQ(target(song), u"/old/x.mp3"_s);
    EXPECT_EQ(RenameTargetByPattern(database, u"%ALBUM%"_s, u":00000000:\\x.mp3"_s, song),
              u":00000000:\\x.mp3"_s);
}

TEST(NamePattern, TheNameIsValidEverywhere) {
    TID3Tag song;
    song.Title = u"con"_s;
    EXPECT_EQ(BuildNameFromPattern(u"%TITLE%"_s, u"/m/x.mp3"_s, song), u"/m/_con.mp3"_s);
    song.Title = u"...\n"_s;
    EXPECT_EQ(BuildNameFromPattern(u"%TITLE%"_s, u"/m/x.mp3"_s, song), u"/m/_.mp3"_s);
}
