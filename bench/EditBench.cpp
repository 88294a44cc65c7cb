// Changes every song of a collection of 100,000, each found by its path: one by one, and as one edit. What
// changes is a field that no order goes by, the artist (every song gets another place), or the count of one
// play.

#include <benchmark/benchmark.h>

#include "MusicManagment/database/CollectionEdit.h"
#include "bench/FakeSongs.h"

namespace {

constexpr int kSongs = 100'000;

using Change = void (*)(TID3Tag& song, int number);

void ChangeComment(TID3Tag& song, int number) {
    song.Comment = QString::number(number);
}

void ChangeArtist(TID3Tag& song, int number) {
    song.Artist = QString::number(number * 7919 % kSongs);
}

void CountPlay(TID3Tag& song, int) {
    ++song.PlayCount;
}

// The songs, in an order that is none of the list's.
QStringList FillCollection(TMusicDatabase& database) {
    QStringList paths;
    database.BeginLoading();
    for (TID3Tag& song : MakeFakeSongs(kSongs)) {
        paths << song.FileName;
        database.AddEntry(QString(), std::move(song), AddAs::Loaded);
    }
    database.EndLoading();
    database.RecountGroups();
    database.EnsureSorted();
    return paths;
}

void OneByOne(benchmark::State& state, Change change) {
    TMusicDatabase database;
    const QStringList paths = FillCollection(database);
    int number = 0;
    for (auto _ : state) {
        for (const QString& path : paths) {
            const SongIndex index = database.IndexOf(path);
            TID3Tag song = database.Song(index);
            change(song, ++number);
            database.UpdateEntry(index, std::move(song));
        }
    }
}

void AsOneEdit(benchmark::State& state, Change change) {
    TMusicDatabase database;
    const QStringList paths = FillCollection(database);
    int number = 0;
    for (auto _ : state) {
        CollectionEdit edit(database);
        for (const QString& path : paths) {
            const TID3Tag* found = database.Songs().Find(path);
            TID3Tag song = *found;
            change(song, ++number);
            edit.Change(database.Songs().HandleOf(*found), std::move(song));
        }
        edit.Commit();
    }
}

BENCHMARK_CAPTURE(OneByOne, Comment, ChangeComment)->Unit(benchmark::kMillisecond)->Iterations(3);
BENCHMARK_CAPTURE(OneByOne, PlayCount, CountPlay)->Unit(benchmark::kMillisecond)->Iterations(3);
BENCHMARK_CAPTURE(OneByOne, Artist, ChangeArtist)->Unit(benchmark::kMillisecond)->Iterations(3);
BENCHMARK_CAPTURE(AsOneEdit, Comment, ChangeComment)->Unit(benchmark::kMillisecond)->Iterations(3);
BENCHMARK_CAPTURE(AsOneEdit, Artist, ChangeArtist)->Unit(benchmark::kMillisecond)->Iterations(3);

}  // namespace

BENCHMARK_MAIN();
