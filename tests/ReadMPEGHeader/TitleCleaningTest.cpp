#include "ReadMPEGHeader/TitleCleaning.h"

#include <gtest/gtest.h>

#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

TID3Tag Cleaned(const QString& artist, const QString& title, TitleCleaning cleaning = {}, quint8 track = 0) {
    TID3Tag tag;
    tag.Artist = artist;
    tag.Title = title;
    tag.Track = track;
    CleanTitles(tag, cleaning);
    return tag;
}

}  // namespace

TEST(TitleCleaning, AnArtistInFrontOfTheTitleIsRemoved) {
    EXPECT_EQ(Cleaned(u"ABBA"_s, u"ABBA - Waterloo"_s).Title, u"Waterloo"_s);
    EXPECT_EQ(Cleaned(u"ABBA"_s, u"ABBA\n/ Waterloo"_s).Title, u"Waterloo"_s);
    EXPECT_EQ(Cleaned(u"ABBA"_s, u"ABBA -- Waterloo"_s).Title, u"- Waterloo"_s);
    EXPECT_EQ(Cleaned(u"ABBA"_s, u"ABBA: Waterloo"_s).Title, u"ABBA: Waterloo"_s);
    EXPECT_EQ(Cleaned(u"KISS"_s, u"Kiss me"_s).Title, u"Kiss me"_s);
    EXPECT_EQ(Cleaned(u""_s, u" - Waterloo"_s).Title, u" - Waterloo"_s);
}

TEST(TitleCleaning, JunkIsDiscardedOnlyWhenAskedFor) {
    const TitleCleaning junk{.RemoveJunkTexts = true};
    for (const auto& title : {u"see WWW.example.org"_s, u"Http://x"_s, u"Track 07"_s, u"title"_s,
                              u"Ripped by X"_s, u"uploaded"_s, u"upped by X"_s}) {
        EXPECT_EQ(Cleaned(u"ABBA"_s, title, junk).Title, u""_s) << title.toStdString();
        EXPECT_EQ(Cleaned(u"ABBA"_s, title).Title, title);
    }
    EXPECT_EQ(Cleaned(u"Artist"_s, u"Artist of the year"_s, junk).Artist, u""_s);
    EXPECT_EQ(Cleaned(u"ABBA"_s, u"Artist of the year"_s, junk).Title, u"Artist of the year"_s);
    EXPECT_EQ(Cleaned(u"Untitled"_s, u"Uppedy"_s, junk).Title, u"Uppedy"_s);
    // What the artist hid in front of a place-holder is seen.
    EXPECT_EQ(Cleaned(u"ABBA"_s, u"ABBA - Track 7"_s, junk).Title, u""_s);
}

TEST(TitleCleaning, ALeadingNumberBecomesTheTrack) {
    const TitleCleaning tracks{.TakeTrackNumbers = true};
    const auto taken = Cleaned(u"ABBA"_s, u"(07) Waterloo"_s, tracks);
    EXPECT_EQ(taken.Track, 7);
    EXPECT_EQ(taken.Title, u"Waterloo"_s);
    for (const auto& title : {u"(256) Waterloo"_s, u"(0) Waterloo"_s, u"() Waterloo"_s, u"(7 Waterloo"_s,
                              u"(Live) Waterloo"_s, u"(99999999999) Waterloo"_s}) {
        const auto kept = Cleaned(u"ABBA"_s, title, tracks);
        EXPECT_EQ(kept.Track, 0);
        EXPECT_EQ(kept.Title, title);
    }
    EXPECT_EQ(Cleaned(u"Nena"_s, u"(99) Luftballons"_s, tracks, 3).Title, u"(99) Luftballons"_s);
    EXPECT_EQ(Cleaned(u"ABBA"_s, u"(7) Waterloo"_s).Track, 0);
}
