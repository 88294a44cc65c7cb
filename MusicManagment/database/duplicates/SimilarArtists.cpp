#include "MusicManagment/database/duplicates/SimilarArtists.h"

#include <algorithm>
#include <numeric>

#include "CommonRUKTools/ColognePhonetics.h"
#include "CommonRUKTools/CompStr.h"
#include "MusicManagment/database/Progress.h"
#include "MusicManagment/database/duplicates/PairSearch.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kSoundPercent = 40;
// Codes of fewer digits say too little.
constexpr qsizetype kShortestCode = 2;

struct Artists {
    std::vector<SortedTextList::Row> Rows;
    std::vector<QByteArray> Sounds;
    ComparedTexts Names;

    explicit Artists(const SortedTextList& list) {
        for (const SortedTextList::Row& row : list) {
            if (row.Text.isEmpty()) continue;
            Rows.push_back(row);
            Sounds.push_back(ColognePhonetics(row.Text));
            Names.Add(row.Text);
        }
        Names.Classify();
    }

    bool SoundAlike(std::size_t a, std::size_t b) const {
        return Sounds[a].size() >= kShortestCode && Sounds[a] == Sounds[b];
    }
};

}  // namespace

std::vector<SimilarArtists> FindSimilarArtists(TMusicDatabase& database, bool& stopped) {
    const ProgressRun run(database, u"Suche nach ähnlich klingenden Artists"_s);
    const Artists artists(database.Artists());
    PairQuery query{.Texts = &artists.Names, .Percent = kSoundPercent};
    query.References.resize(artists.Rows.size());
    std::iota(query.References.begin(), query.References.end(), 0);
    std::vector<SimilarArtists> pairs;
    qint64 done = 0;
    const auto goOn = [&] {
        return !database.Progress({.Cur = done, .Max = static_cast<qint64>(artists.Rows.size())});
    };
    const auto found = [&](std::uint32_t first, std::span<const TextBlocks::Match> matches) {
        for (const auto& [second, distance] : matches) {
            const auto longer = std::max(artists.Names.Length(first), artists.Names.Length(second));
            if (!IsAlike(distance, longer) && !artists.SoundAlike(first, second)) continue;
            const auto& [text1, songs1] = artists.Rows[first];
            const auto& [text2, songs2] = artists.Rows[second];
            pairs.push_back({Similarity(distance, longer), text1, text2, songs1, songs2});
        }
        return ++done % 64 != 0 || goOn();
    };
    stopped = !SearchPairs(query, found, goOn);
    std::ranges::stable_sort(pairs, std::ranges::greater{}, &SimilarArtists::Percent);
    return pairs;
}

BatchResult UnifyArtists(TMusicDatabase& database, const QStringList& artists, const QString& spelling) {
    std::vector<SongUpdate> updates;
    for (SongIndex index = 0; index < database.Count(); ++index) {
        const TID3Tag& song = database.Song(index);
        if (song.Artist == spelling || !artists.contains(song.Artist)) continue;
        SongUpdate update{.Song = database.Songs().HandleOf(index), .Basis = song, .Record = song};
        update.Record.Artist = spelling;
        updates.push_back(std::move(update));
    }
    if (updates.empty()) return {};
    return UpdateSongs(database, u"Artist vereinheitlichen ("_s + SongCountText(updates.size()) + u')',
                       updates, Renaming::BySettings);
}
