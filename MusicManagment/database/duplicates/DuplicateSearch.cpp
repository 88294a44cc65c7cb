#include "MusicManagment/database/duplicates/DuplicateSearch.h"

#include <QHash>
#include <QThread>
#include <algorithm>
#include <limits>
#include <numeric>

#include "CommonRUKTools/Clock.h"
#include "MusicManagment/database/Progress.h"
#include "MusicManagment/database/duplicates/PairSearch.h"
#include "ReadMPEGHeader/DisplayTexts.h"

using namespace Qt::StringLiterals;

namespace {

constexpr qint64 kProgressEvery = 50;  // milliseconds
// What a thread does at least on a processor of our days.
constexpr double kPairsPerSecond = 100e6;

QString KeyOf(const TID3Tag& song, bool sameArtistOnly) {
    return sameArtistOnly ? song.Title : ArtistAndTitle(song);
}

// The songs that take part, numbered in the order of the collection, and what is compared of them. Copies:
// the collection may change while the search goes on.
class Participants {
 public:
    Participants(const TMusicDatabase& database, const DuplicateQuery& query) {
        const std::vector<SongIndex> references = PlacesOf(database, query.References);
        std::vector<SongIndex> places = references;
        if (!query.AmongReferencesOnly || references.empty()) {
            places.resize(static_cast<std::size_t>(database.Count()));
            std::iota(places.begin(), places.end(), 0);
        }
        for (const SongIndex place : places)
            Add(database, place, query.SameArtistOnly);
        texts_.Classify();
        for (std::uint32_t number = 0; number < places.size(); ++number)
            if (query.References.empty() || std::ranges::binary_search(references, places[number]))
                references_.push_back(number);
    }

    const ComparedTexts& Texts() const { return texts_; }
    std::vector<SongHandle> TakeSongs() { return std::move(songs_); }
    PairQuery Query(int percent) {
        return {.Texts = &texts_,
                .Groups = std::move(artists_),
                .References = std::move(references_),
                .Percent = percent};
    }

 private:
    // Ascending, each once, of the songs that are still there.
    static std::vector<SongIndex> PlacesOf(const TMusicDatabase& database,
                                           const std::vector<SongHandle>& songs) {
        std::vector<SongIndex> places;
        for (const SongHandle song : songs)
            if (const SongIndex place = database.Songs().PositionOf(song); place >= 0)
                places.push_back(place);
        std::ranges::sort(places);
        places.erase(std::unique(places.begin(), places.end()), places.end());
        return places;
    }

    void Add(const TMusicDatabase& database, SongIndex place, bool sameArtistOnly) {
        const TID3Tag& song = database.Song(place);
        songs_.push_back(database.Songs().HandleOf(place));
        texts_.Add(KeyOf(song, sameArtistOnly));
        if (!sameArtistOnly) return;
        const auto next = static_cast<std::uint32_t>(numberOfArtist_.size());
        const auto known = numberOfArtist_.find(song.Artist.toCaseFolded());
        artists_.push_back(known != numberOfArtist_.end()
                               ? *known
                               : *numberOfArtist_.insert(song.Artist.toCaseFolded(), next));
    }

    std::vector<SongHandle> songs_;
    ComparedTexts texts_;
    QHash<QString, std::uint32_t> numberOfArtist_;
    std::vector<std::uint32_t> artists_;  // a song; empty when they do not count
    std::vector<std::uint32_t> references_;
};

// Tells how far the search is, and lets the interface work, so often that it stays smooth.
class SearchProgress {
 public:
    SearchProgress(TMusicDatabase& database, std::size_t references, const std::function<void()>& onRows)
        : database_(database), references_(references), onRows_(onRows) {}

    // False when the user wants no more.
    bool Reach(std::size_t done) {
        const qint64 now = CurrentClock().Ticks();
        if (now < next_) return true;
        next_ = now + kProgressEvery;
        if (onRows_) onRows_();
        stopped_ =
            database_.Progress({.Cur = static_cast<qint64>(done), .Max = static_cast<qint64>(references_)});
        return !stopped_;
    }
    bool Stopped() const { return stopped_; }

 private:
    TMusicDatabase& database_;
    std::size_t references_;
    const std::function<void()>& onRows_;
    qint64 next_ = 0;
    bool stopped_ = false;
};

}  // namespace

void DuplicateRows::Begin(std::vector<SongHandle> songs) {
    rows_.clear();
    songs_ = std::move(songs);
}

void DuplicateRows::Add(std::uint32_t first, std::uint32_t second, std::size_t distance, std::size_t length) {
    // Of names too long for the row the ratio stays; one letter stays a difference.
    const std::size_t scale = length / (std::numeric_limits<std::uint16_t>::max() + std::size_t{1}) + 1;
    const std::size_t scaled = distance == 0 ? 0 : std::max<std::size_t>(distance / scale, 1);
    rows_.push_back(
        {first, second, static_cast<std::uint16_t>(scaled), static_cast<std::uint16_t>(length / scale)});
}

DuplicateEnd FindDuplicates(TMusicDatabase& database, const DuplicateQuery& query, DuplicateRows& rows,
                            const std::function<void()>& onRows) {
    const ProgressRun run(database, u"Suche nach doppelten Einträgen"_s);
    Participants participants(database, query);
    rows.Begin(participants.TakeSongs());
    const ComparedTexts& texts = participants.Texts();
    const PairQuery pairs = participants.Query(query.LeastPercent);
    SearchProgress progress(database, pairs.References.size(), onRows);
    std::size_t done = 0;
    const auto found = [&](std::uint32_t reference, std::span<const TextBlocks::Match> matches) {
        for (const TextBlocks::Match& match : matches) {
            if (rows.Count() == kMostDuplicateRows) return false;
            const auto longer = std::max(texts.Length(reference), texts.Length(match.Number));
            rows.Add(reference, match.Number, match.Distance, longer);
        }
        return progress.Reach(++done);
    };
    const bool isWhole = SearchPairs(pairs, found, [&] { return progress.Reach(done); });
    if (onRows) onRows();
    if (isWhole) return DuplicateEnd::Done;
    return progress.Stopped() ? DuplicateEnd::Stopped : DuplicateEnd::TooManyRows;
}

double ExpectedSearchTime(std::size_t songs) {
    const double pairs = static_cast<double>(songs) * static_cast<double>(songs) / 2;
    return pairs / (kPairsPerSecond * QThread::idealThreadCount());
}

QString SimilarityText(double percent) {
    return percent == 100 ? u"100%"_s : u' ' + QString::number(percent, 'f', 1);
}

QString ComparedName(const TID3Tag& song, bool sameArtistOnly) {
    return (IsCdPath(song.FileName) ? u"[CD] "_s : QString()) + KeyOf(song, sameArtistOnly).toLower();
}
