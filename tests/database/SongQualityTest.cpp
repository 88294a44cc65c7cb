#include "MusicManagment/database/duplicates/SongQuality.h"

#include <gtest/gtest.h>

#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

namespace {

TID3Tag Song(quint16 bitRate, quint16 length = 200, quint32 plays = 0, const QString& album = {}) {
    TID3Tag song;
    song.Title = u"T"_s;
    song.BitRate = bitRate;
    song.Length = length;
    song.PlayCount = plays;
    song.Album = album;
    return song;
}

TEST(SongQuality, TheFirstQualityThatDiffersDecides) {
    using Side = SongVerdict::Side;
    TID3Tag damaged = Song(320);
    damaged.Flags = sfDamaged;
    TID3Tag onCd = Song(320);
    onCd.FileName = u":00000001:\\A.mp3"_s;
    const struct {
        TID3Tag First;
        TID3Tag Second;
        Side Better;
        QString Reason;
    } cases[] = {
        {Song(320), Song(320), Side::Neither, u""_s},
        {damaged, Song(128), Side::Second, u"nicht als beschädigt gekennzeichnet"_s},
        {Song(128), onCd, Side::First, u"nicht auf einem Medium, das fehlen kann"_s},
        {Song(320, 100), Song(128, 200), Side::First, u"höhere Bitrate (320 statt 128 kBit/s)"_s},
        {Song(320, 200), Song(320, 206), Side::Second, u"länger (3:26 statt 3:20)"_s},
        {Song(320, 200), Song(320, 205, 0, u"A"_s), Side::Second,
         u"vollständigerer Tag (2 statt 1 Feldern)"_s},
        {Song(320, 200, 5), Song(320, 205, 1), Side::First, u"öfter gespielt (5 statt 1 Mal)"_s},
    };
    for (const auto& [first, second, better, reason] : cases) {
        const SongVerdict verdict = CompareQuality(first, second);
        EXPECT_EQ(verdict.Better, better) << reason.toStdString();
        EXPECT_EQ(verdict.Reason, reason);
    }
}

TEST(SongQuality, NoneThatStaysForAnotherGoesAndNoneGoesWithoutABetterPartner) {
    TMusicDatabase database;
    std::vector<SongHandle> songs;
    const auto add = [&](const TID3Tag& record) {
        TID3Tag song = record;
        song.FileName = u":00000001:\\%1.mp3"_s.arg(songs.size());
        songs.push_back(database.Songs().HandleOf(database.AddEntry(QString(), song)));
    };
    // 3 is like 2 only; 4 is another recording; 5 and 6 are equally good.
    for (const TID3Tag& song :
         {Song(128), Song(320), Song(192), Song(64), Song(320, 300), Song(96), Song(96)})
        add(song);
    std::vector<DuplicatePair> pairs = {{songs[0], songs[1]}, {songs[0], songs[2]}, {songs[1], songs[2]},
                                        {songs[2], songs[3]}, {songs[1], songs[4]}, {songs[5], songs[6]}};
    using Found = std::vector<std::pair<SongHandle, SongHandle>>;
    const auto suggested = [&] {
        Found found;
        for (const KeepSuggestion& suggestion : SuggestKept(database, pairs))
            found.emplace_back(suggestion.Songs.Kept, suggestion.Songs.Dropped);
        return found;
    };
    EXPECT_EQ(suggested(), (Found{{songs[1], songs[0]}, {songs[1], songs[2]}, {songs[5], songs[6]}}));
    pairs[3].Percent = 100;  // now 2 stays for its copy, though 1 is better
    EXPECT_EQ(suggested(), (Found{{songs[2], songs[3]}, {songs[1], songs[0]}, {songs[5], songs[6]}}));
}

}  // namespace
