// Loading and saving a collection of a million songs, each beside what the work cannot go below: zlib alone
// on the same bytes. Loading has SQLite, reading the same rows into the same records, as a second peer.

#include <benchmark/benchmark.h>
#include <malloc.h>
#include <unistd.h>
#include <zlib.h>

#include <QCoreApplication>
#include <QTemporaryDir>
#include <fstream>

#include "CommonRUKTools/FileSource.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/tsdb/DatabaseFile.h"
#include "bench/FakeSongs.h"
#include "bench/SqliteSongs.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kSongs = 1'000'000;
constexpr int kHeaderSize = 17;
constexpr std::size_t kBuffer = std::size_t{256} * 1024;

void Fill(TMusicDatabase& database, int count) {
    database.BeginLoading();
    for (TID3Tag& song : MakeFakeSongs(count))
        database.AddEntry(QString(), std::move(song), AddAs::Loaded);
    database.EndLoading();
    database.Resort();
    database.RecountGroups();
}

// The files that all benchmarks read, made once.
class Files {
 public:
    static Files& Get() {
        static Files files;
        return files;
    }
    QString Database() const { return folder_.filePath(u"songs.tsdb"_s); }
    QString Sqlite() const { return folder_.filePath(u"songs.sqlite"_s); }
    QString Scratch() const { return folder_.filePath(u"scratch.tsdb"_s); }

    std::vector<std::uint8_t> CompressedBody() const {
        FileSource file(Database());
        return file.ReadExactly(kHeaderSize, static_cast<std::size_t>(file.Size() - kHeaderSize));
    }

 private:
    Files() {
        TMusicDatabase database;
        Fill(database, kSongs);
        database.SaveDatabase(Database());
        WriteSqliteSongs(Sqlite(), database.Songs());
    }
    QTemporaryDir folder_;
};

// Bytes of this process in memory.
std::size_t ResidentSize() {
    std::ifstream file("/proc/self/statm");
    std::size_t total = 0;
    std::size_t resident = 0;
    file >> total >> resident;
    return resident * static_cast<std::size_t>(sysconf(_SC_PAGESIZE));
}

template <typename Handler>
std::size_t InflateAll(const std::vector<std::uint8_t>& body, Handler handler) {
    std::vector<std::uint8_t> buffer(kBuffer);
    z_stream zlib{};
    inflateInit(&zlib);
    zlib.next_in = const_cast<Bytef*>(body.data());
    zlib.avail_in = static_cast<uInt>(body.size());
    int result = Z_OK;
    while (result == Z_OK) {
        zlib.next_out = buffer.data();
        zlib.avail_out = static_cast<uInt>(buffer.size());
        result = inflate(&zlib, Z_NO_FLUSH);
        handler(buffer.data(), buffer.size() - zlib.avail_out);
    }
    const std::size_t size = zlib.total_out;
    inflateEnd(&zlib);
    return size;
}

std::vector<std::uint8_t> InflatedBody() {
    std::vector<std::uint8_t> inflated;
    InflateAll(Files::Get().CompressedBody(), [&inflated](const std::uint8_t* bytes, std::size_t size) {
        inflated.insert(inflated.end(), bytes, bytes + size);
    });
    return inflated;
}

void MemoryAfterLoad(benchmark::State& state) {
    const QString path = Files::Get().Database();
    for (auto _ : state) {
        malloc_trim(0);
        const std::size_t before = ResidentSize();
        TMusicDatabase database;
        database.OpenDatabase(path);
        malloc_trim(0);
        state.counters["resident_bytes_per_song"] =
            static_cast<double>(ResidentSize() - before) / database.Count();
    }
}

void LoadDatabase(benchmark::State& state) {
    const QString path = Files::Get().Database();
    for (auto _ : state) {
        auto database = std::make_unique<TMusicDatabase>();
        database->OpenDatabase(path);
        benchmark::DoNotOptimize(database->Count());
        state.PauseTiming();
        database.reset();
        state.ResumeTiming();
    }
    state.counters["songs/s"] = benchmark::Counter(kSongs, benchmark::Counter::kIsIterationInvariantRate);
}

void LoadPeerInflate(benchmark::State& state) {
    const auto body = Files::Get().CompressedBody();
    std::size_t size = 0;
    for (auto _ : state)
        size =
            InflateAll(body, [](const std::uint8_t* bytes, std::size_t) { benchmark::DoNotOptimize(bytes); });
    state.counters["body_bytes"] = static_cast<double>(size);
    state.counters["compressed_bytes"] = static_cast<double>(body.size());
}

void LoadPeerSqlite(benchmark::State& state) {
    const QString path = Files::Get().Sqlite();
    for (auto _ : state) {
        auto songs = ReadSqliteSongs(path);
        benchmark::DoNotOptimize(songs.size());
        state.PauseTiming();
        songs = {};
        state.ResumeTiming();
    }
}

TMusicDatabase& LoadedDatabase() {
    static TMusicDatabase database;
    if (database.Count() == 0) database.OpenDatabase(Files::Get().Database());
    return database;
}

void SaveDatabase(benchmark::State& state) {
    TMusicDatabase& database = LoadedDatabase();
    for (auto _ : state) {
        SafeFile file(Files::Get().Scratch());
        WriteDatabase(database, file);
    }
}

// With the wait for the disk, which zlib alone does not have.
void SaveDatabaseAndFlush(benchmark::State& state) {
    TMusicDatabase& database = LoadedDatabase();
    for (auto _ : state)
        database.SaveDatabase(Files::Get().Scratch(), true);
}

void SavePeerDeflate(benchmark::State& state) {
    const auto body = InflatedBody();
    std::vector<std::uint8_t> buffer(kBuffer);
    for (auto _ : state) {
        z_stream zlib{};
        deflateInit(&zlib, Z_BEST_SPEED);
        zlib.next_in = const_cast<Bytef*>(body.data());
        zlib.avail_in = static_cast<uInt>(body.size());
        int result = Z_OK;
        while (result == Z_OK) {
            zlib.next_out = buffer.data();
            zlib.avail_out = static_cast<uInt>(buffer.size());
            result = deflate(&zlib, Z_FINISH);
            benchmark::DoNotOptimize(buffer.data());
        }
        deflateEnd(&zlib);
    }
}

BENCHMARK(MemoryAfterLoad)->Iterations(1)->Unit(benchmark::kMillisecond);
BENCHMARK(LoadDatabase)->Iterations(3)->Unit(benchmark::kMillisecond);
BENCHMARK(LoadPeerInflate)->Iterations(3)->Unit(benchmark::kMillisecond);
BENCHMARK(LoadPeerSqlite)->Iterations(3)->Unit(benchmark::kMillisecond);
BENCHMARK(SaveDatabase)->Iterations(2)->Unit(benchmark::kMillisecond);
BENCHMARK(SaveDatabaseAndFlush)->Iterations(2)->Unit(benchmark::kMillisecond);
BENCHMARK(SavePeerDeflate)->Iterations(2)->Unit(benchmark::kMillisecond);

}  // namespace

int main(int argc, char** argv) {
    // The progress points of a run let events through only where there is an application.
    const QCoreApplication application(argc, argv);
    benchmark::Initialize(&argc, argv);
    benchmark::RunSpecifiedBenchmarks();
}
