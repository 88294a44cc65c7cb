#include "MusicManagment/database/search/SongFilter.h"

#include <gtest/gtest.h>

#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

TID3Tag Song() {
    TID3Tag song;
    song.FileName = u"/musik/Die Ärzte/Debil/07 - Zu spät.mp3"_s;
    song.Title = u"Zu spät"_s;
    song.Artist = u"Die Ärzte"_s;
    song.Album = u"Debil"_s;
    song.Year = u"1984"_s;
    song.Comment = u"von Kassette"_s;
    song.MPEGLayer = u"MPEG 1.0 Layer III"_s;
    song.Length = 215;
    song.BitRate = 192;
    song.MainGenre = 3;
    song.Genre = 17;
    song.PlayCount = 5;
    song.Flags = 8;
    return song;
}

struct FilterCase {
    QString Typed;
    bool Matches;
};

class SongFilterTest : public testing::TestWithParam<FilterCase> {};

}  // namespace

TEST_P(SongFilterTest, DecidesAboutTheSong) {
    EXPECT_EQ(SongFilter::Parse(GetParam().Typed).Matches(Song()), GetParam().Matches)
        << GetParam().Typed.toStdString();
}

INSTANTIATE_TEST_SUITE_P(
    Words, SongFilterTest,
    testing::Values(FilterCase{u""_s, true}, FilterCase{u"spat arzte"_s, true},
                    FilterCase{u"ÄRZTE debil kassette"_s, true}, FilterCase{u"spät toten"_s, false},
                    FilterCase{u"\"zu spät\""_s, true}, FilterCase{u"\"spät zu\""_s, false},
                    FilterCase{u"arzte -debil"_s, false}, FilterCase{u"arzte -hosen"_s, true},
                    FilterCase{u"07"_s, true}, FilterCase{u"-"_s, true}, FilterCase{u"\""_s, true}));

INSTANTIATE_TEST_SUITE_P(
    Fields, SongFilterTest,
    testing::Values(FilterCase{u"artist:ärzte"_s, true}, FilterCase{u"artist:debil"_s, false},
                    FilterCase{u"ARTIST:\"die ärzte\" titel:spat"_s, true}, FilterCase{u"artist:"_s, true},
                    FilterCase{u"jahr:1980..1989"_s, true}, FilterCase{u"jahr:1985..1989"_s, false},
                    FilterCase{u"jahr:..1984"_s, true}, FilterCase{u"jahr:1985.."_s, false},
                    FilterCase{u"jahr:1984"_s, true}, FilterCase{u"-jahr:1984"_s, false},
                    FilterCase{u"bitrate:>=192"_s, true}, FilterCase{u"bitrate:>192"_s, false},
                    FilterCase{u"bitrate:>="_s, true}, FilterCase{u"bitrate:<193"_s, true},
                    FilterCase{u"länge:3:35"_s, true}, FilterCase{u"länge:<3:30"_s, false},
                    FilterCase{u"länge:200..3:40"_s, true}, FilterCase{u"genre:rock"_s, true},
                    FilterCase{u"genre:metal"_s, false}, FilterCase{u"flag:remix"_s, true},
                    FilterCase{u"beliebtheit:5"_s, true}, FilterCase{u"unbekannt:feld"_s, false},
                    FilterCase{u"jahr:neunzehn"_s, false},
                    FilterCase{u"bitrate:99999999999999999999"_s, false}));
