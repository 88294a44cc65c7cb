// Files per second that are read from a warm cache, beside TagLib on the same files; and a whole run of the
// command line program over their folder, with its save. The number of files is TUNESTEAD_BENCH_SONGS, 10000
// without it.

#include <benchmark/benchmark.h>
#include <fileref.h>
#include <tag.h>

#include <QFile>
#include <QProcess>
#include <QTemporaryDir>

#include "CommonRUKTools/Errors.h"
#include "ReadMPEGHeader/AudioFile.h"
#include "bench/SongGenerator.h"

namespace {

const QTemporaryDir& Folder() {
    static const QTemporaryDir folder;
    return folder;
}

// Written once for all benchmarks of a run.
const QStringList& Songs() {
    static const QStringList paths = [] {
        SongGenerator generator;
        const int wanted = qEnvironmentVariableIntValue("TUNESTEAD_BENCH_SONGS");
        if (wanted > 0) generator.Songs = wanted;
        return generator.Write(Folder().filePath(QStringLiteral("songs")));
    }();
    return paths;
}

void ReadOurs(benchmark::State& state, ReadProfile profile) {
    ReadOptions options;
    options.Profile = profile;
    const QStringList& songs = Songs();
    for (auto _ : state) {
        for (const QString& path : songs) {
            TID3Tag tag;
            ReadAudioFile(path, options, tag);
            if (tag.Title.isEmpty() || tag.Length == 0) state.SkipWithError("a song was not understood");
            benchmark::DoNotOptimize(tag);
        }
    }
    state.SetItemsProcessed(state.iterations() * songs.size());
}

void ReadTagLib(benchmark::State& state) {
    const QStringList& songs = Songs();
    std::vector<QByteArray> names;
    for (const QString& path : songs)
        names.push_back(QFile::encodeName(path));
    for (auto _ : state) {
        for (const QByteArray& name : names) {
            const TagLib::FileRef file(name.constData(), true, TagLib::AudioProperties::Fast);
            const TagLib::Tag* tag = file.tag();
            const TagLib::String texts[] = {tag->title(), tag->artist(), tag->album(), tag->genre(),
                                            tag->comment()};
            const unsigned numbers[] = {tag->year(), tag->track(),
                                        static_cast<unsigned>(file.audioProperties()->lengthInSeconds())};
            if (texts[0].isEmpty() || numbers[2] == 0) state.SkipWithError("a song was not understood");
            benchmark::DoNotOptimize(texts);
            benchmark::DoNotOptimize(numbers);
        }
    }
    state.SetItemsProcessed(state.iterations() * songs.size());
}

void BM_Classic(benchmark::State& state) {
    ReadOurs(state, ReadProfile::Classic);
}
void BM_Modern(benchmark::State& state) {
    ReadOurs(state, ReadProfile::Modern);
}
void BM_TagLib(benchmark::State& state) {
    ReadTagLib(state);
}

// From the start of the program to its end: walk, read, sort in, save with the flush to the disk.
void BM_ScanAndSave(benchmark::State& state) {
    const qsizetype count = Songs().size();
    const QString database = Folder().filePath(QStringLiteral("songs.tsdb"));
    const QStringList arguments{QStringLiteral("scan"), QStringLiteral("--db"), database,
                                Folder().filePath(QStringLiteral("songs"))};
    for (auto _ : state) {
        QFile::remove(database);
        QProcess scan;
        scan.setProcessChannelMode(QProcess::ForwardedErrorChannel);
        scan.start(QStringLiteral(TUNESTEAD_CLI), arguments);
        if (!scan.waitForFinished(-1) || scan.exitCode() != 0 || !QFile::exists(database))
            state.SkipWithError("the scan failed");
    }
    state.SetItemsProcessed(state.iterations() * count);
}

BENCHMARK(BM_Classic)->Unit(benchmark::kMillisecond)->UseRealTime();
BENCHMARK(BM_Modern)->Unit(benchmark::kMillisecond)->UseRealTime();
BENCHMARK(BM_ScanAndSave)->Unit(benchmark::kMillisecond)->UseRealTime();
BENCHMARK(BM_TagLib)->Unit(benchmark::kMillisecond)->UseRealTime();

}  // namespace

BENCHMARK_MAIN();
