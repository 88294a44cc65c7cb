#include "MusicManagment/database/songfiles/NamePattern.h"

#include <gtest/gtest.h>

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

TEST(NamePattern, TheNameIsValidEverywhere) {
    TID3Tag song;
    song.Title = u"con"_s;
    EXPECT_EQ(BuildNameFromPattern(u"%TITLE%"_s, u"/m/x.mp3"_s, song), u"/m/_con.mp3"_s);
    song.Title = u"...\n"_s;
    EXPECT_EQ(BuildNameFromPattern(u"%TITLE%"_s, u"/m/x.mp3"_s, song), u"/m/_.mp3"_s);
}
