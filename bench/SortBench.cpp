// Sorts a million songs by genre, artist, title and length, and takes one more song into them.

#include <benchmark/benchmark.h>

#include <QCollator>
#include <algorithm>
#include <random>

#include "CommonRUKTools/Collation.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/sorting/Sorting.h"
#include "bench/FakeSongs.h"

namespace {

constexpr int kSongs = 1'000'000;
constexpr int kNewSongs = 20'000;
const SongOrder kOrder{stGenre, sstGATL};

using Entries = std::vector<SongList::Entry>;

// The songs of the collection and behind them the new ones, in random order.
const std::vector<TID3Tag>& Songs() {
    static const std::vector<TID3Tag> songs = [] {
        auto made = MakeFakeSongs(kSongs + kNewSongs);
        std::shuffle(made.begin(), made.end(), std::mt19937(1));
        return made;
    }();
    return songs;
}

Entries MakeEntries() {
    Entries entries;
    entries.reserve(kSongs);
    for (std::size_t i = 0; i < kSongs; ++i)
        entries.push_back(std::make_unique<SongEntry>(Songs()[i]));
    return entries;
}

void SortSongsInPlace(Entries& entries) {
    SortSongs(kOrder, entries);
}

// The peer: the system's sort keys of every artist and title, and a sort by them.
void SortByCollatorKeys(Entries& entries) {
    struct Keys {
        quint8 genre;
        QCollatorSortKey artist;
        QCollatorSortKey title;
        quint16 length;
        SongList::Entry entry;
    };
    const QCollator& collator = Collation::CaseInsensitive();
    std::vector<Keys> keys;
    keys.reserve(entries.size());
    for (auto& entry : entries) {
        const TID3Tag& song = *entry;
        keys.push_back({song.MainGenre, collator.sortKey(song.Artist), collator.sortKey(song.Title),
                        song.Length, std::move(entry)});
    }
    std::sort(keys.begin(), keys.end(), [](const Keys& a, const Keys& b) {
        if (a.genre != b.genre) return a.genre < b.genre;
        int result = a.artist.compare(b.artist);
        if (result == 0) result = a.title.compare(b.title);
        return result != 0 ? result < 0 : a.length < b.length;
    });
    for (std::size_t i = 0; i < keys.size(); ++i)
        entries[i] = std::move(keys[i].entry);
}

void Sort(benchmark::State& state, void (*sort)(Entries&)) {
    for (auto _ : state) {
        state.PauseTiming();
        auto entries = MakeEntries();
        state.ResumeTiming();
        sort(entries);
        state.PauseTiming();
        entries.clear();
        state.ResumeTiming();
    }
}

void FillCollection(TMusicDatabase& database) {
    database.BeginLoading();
    for (std::size_t i = 0; i < kSongs; ++i)
        database.AddEntry(QString(), Songs()[i], AddAs::Loaded);
    database.EndLoading();
    database.EnsureSorted();
}

void TakeOneSongIn(benchmark::State& state) {
    TMusicDatabase database;
    FillCollection(database);
    std::size_t next = kSongs;
    for (auto _ : state)
        benchmark::DoNotOptimize(database.AddEntry(QString(), Songs()[next++], AddAs::Loaded));
}

BENCHMARK_CAPTURE(Sort, SortSongs, SortSongsInPlace)->Unit(benchmark::kMillisecond)->Iterations(4);
BENCHMARK_CAPTURE(Sort, CollatorKeys, SortByCollatorKeys)->Unit(benchmark::kMillisecond)->Iterations(4);
BENCHMARK(TakeOneSongIn)->Unit(benchmark::kMicrosecond)->Iterations(kNewSongs);

}  // namespace

BENCHMARK_MAIN();
