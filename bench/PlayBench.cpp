// What playing costs: processor time (of all threads) for a second that is played, of one stream and while
// two are cross-faded, beside decoding alone and beside the ffmpeg program; the time from opening a file to
// its first sound; time and error of a seek. The output is one that takes the mix as fast as it comes.

#include <benchmark/benchmark.h>

#include <QProcess>
#include <QTemporaryDir>
#include <QThread>
#include <random>
#include <thread>

#include "MusicManagment/playback/fmod/FFmpegSource.h"
#include "MusicManagment/playback/fmod/SinkOutput.h"
#include "MusicManagment/playback/fmod/SoundLibrary.h"
#include "bench/ProcessorTime.h"
#include "tests/playback/SoundFiles.h"

namespace {

constexpr int kRate = 44100;
constexpr double kSeconds = 60;
constexpr std::size_t kFrames = kRate;  // played at a time: one second

// Three voices with noise, rising and falling: something for an encoder to do.
Samples Music() {
    Samples samples = Sweep(kSeconds);
    std::mt19937 random(1);
    std::uniform_real_distribution<float> noise(-0.1F, 0.1F);
    for (std::size_t i = 0; i < samples.size(); ++i) {
        const double time = static_cast<double>(i / 2) / kRate;
        const double swell = 0.5 + 0.5 * std::sin(time * 3);
        samples[i] =
            static_cast<float>(0.5 * samples[i] + 0.15 * std::sin(time * 2764) * swell) + noise(random);
    }
    return samples;
}

struct File {
    const char* name;
    Encoding encoding;
};
constexpr File kFiles[] = {
    {"cbr.mp3", {.codec = "libmp3lame", .format = "mp3"}},
    {"vbr.mp3", {.codec = "libmp3lame", .format = "mp3", .bitRate = 0}},
    {"bare-vbr.mp3", {.codec = "libmp3lame", .format = "mp3", .bitRate = 0, .header = false}},
    {"a.wma", {.codec = "wmav2", .format = "asf"}},
    {"a.ogg", {.codec = "libvorbis", .format = "ogg"}},
    {"a.wav", {.codec = "pcm_s16le", .format = "wav"}},
};

// Encoded once for all benchmarks of a run.
QString Path(std::size_t file) {
    static const QTemporaryDir folder;
    static const Samples music = Music();
    const QString path = folder.filePath(QString::fromLatin1(kFiles[file].name));
    if (!QFile::exists(path)) Encode(path, music, kFiles[file].encoding);
    return path;
}

// The library over an output that is pulled by hand.
class Player {
 public:
    explicit Player(OutputFactory outputs = OutputsFor({.kind = OutputChoice::Kind::Null, .unpaced = true}))
        : library(std::move(outputs)) {
        library.FSOUND_Init(kRate, 32, 2);
    }
    FSOUND_STREAM Start(const QString& path) {
        const FSOUND_STREAM stream = library.FSOUND_Stream_OpenFile(path, 0x20029);
        channel = library.FSOUND_Stream_PlayEx(stream, FSOUND_FREE, FSOUND_DSPUNIT::kNone, false);
        return stream;
    }
    SoundLibrary library;
    int channel = -1;
};

void Name(benchmark::State& state) {
    state.SetLabel(kFiles[static_cast<std::size_t>(state.range(0))].name);
}

// Items are played seconds: the time an item is the figure.
void PlayStreams(benchmark::State& state, int streams) {
    Player player;
    std::vector<FSOUND_STREAM> playing;
    for (int i = 0; i < streams; ++i)
        playing.push_back(player.Start(Path(static_cast<std::size_t>(state.range(0)))));
    int second = 0;
    for (auto _ : state) {
        if (++second % 50 == 0)
            for (const FSOUND_STREAM stream : playing)
                player.library.FSOUND_Stream_SetTime(stream, 0);
        player.library.FSOUND_SetVolume(player.channel, second % 256);
        player.library.Advance(kFrames);
    }
    if (player.library.FramesStarved() != 0) state.SkipWithError("a stream came too late");
    Name(state);
}
void PlayOne(benchmark::State& state) {
    PlayStreams(state, 1);
}
void PlayCrossFade(benchmark::State& state) {
    PlayStreams(state, 2);
}

constexpr int kHeardSeconds = 5;

// Processor time of a second that passes while something goes on at the pace of hearing.
void MeasureRealTime(benchmark::State& state, const std::function<void()>& hear) {
    double spent = 0;
    for (auto _ : state) {
        const double before = ProcessorTime(RUSAGE_SELF);
        hear();
        spent += ProcessorTime(RUSAGE_SELF) - before;
    }
    state.counters["CPU ms a second"] = spent / static_cast<double>(state.iterations()) / kHeardSeconds;
    Name(state);
}

// As it is at the user's: the threads sleep in between, and one decodes while the other rests.
void PlayInRealTime(benchmark::State& state, int streams) {
    Player player(OutputsFor({.kind = OutputChoice::Kind::Null}));
    for (int i = 0; i < streams; ++i)
        player.Start(Path(static_cast<std::size_t>(state.range(0))));
    QThread::sleep(1);  // the first half second is decoded at once
    MeasureRealTime(state, [] { QThread::sleep(kHeardSeconds); });
}
void RealTimeOne(benchmark::State& state) {
    PlayInRealTime(state, 1);
}
void RealTimeCrossFade(benchmark::State& state) {
    PlayInRealTime(state, 2);
}

// What any player pays at the least: one thread that decodes a buffer and sleeps until it is used up.
void RealTimeDecodeOnly(benchmark::State& state) {
    constexpr std::size_t kBuffer = 4096;
    FFmpegSource source(Path(static_cast<std::size_t>(state.range(0))), FFmpegFile::LengthBy::Header, kRate);
    Samples buffer(2 * kBuffer);
    MeasureRealTime(state, [&] {
        auto due = std::chrono::steady_clock::now();
        for (std::size_t i = 0; i < kHeardSeconds * kFrames / kBuffer; ++i) {
            source.Read(buffer.data(), kBuffer);
            due += std::chrono::microseconds(1'000'000 * kBuffer / kRate);
            std::this_thread::sleep_until(due);
        }
    });
}

void DecodeOnly(benchmark::State& state) {
    FFmpegSource source(Path(static_cast<std::size_t>(state.range(0))), FFmpegFile::LengthBy::Header, kRate);
    Samples second(2 * kFrames);
    int seconds = 0;
    for (auto _ : state) {
        if (++seconds % 50 == 0) source.Seek(0);
        if (source.Read(second.data(), kFrames) < kFrames) state.SkipWithError("the file ended");
    }
    Name(state);
}

// The ffmpeg program decodes the whole file; its start is part of it.
void DecodeByProgram(benchmark::State& state) {
    const QString path = Path(static_cast<std::size_t>(state.range(0)));
    const QString command = QStringLiteral("ffmpeg -v quiet -threads 1 -i %1 -f null -").arg(path);
    const double before = ProcessorTime(RUSAGE_CHILDREN);
    for (auto _ : state) {
        if (QProcess::execute(QStringLiteral("/bin/sh"), {QStringLiteral("-c"), command}) != 0)
            return state.SkipWithError("no ffmpeg");
    }
    const double spent = ProcessorTime(RUSAGE_CHILDREN) - before;
    state.counters["CPU ms a second"] = spent / static_cast<double>(state.iterations()) / kSeconds;
    Name(state);
}

void OpenToFirstSound(benchmark::State& state) {
    Player player;
    const QString path = Path(static_cast<std::size_t>(state.range(0)));
    for (auto _ : state) {
        const FSOUND_STREAM stream = player.Start(path);
        player.library.Advance(Mixer::kBlock);
        player.library.FSOUND_Stream_Close(stream);
    }
    Name(state);
}

// Where in `all`, near `place`, the piece stands.
std::size_t Find(const Samples& piece, const Samples& all, std::size_t place) {
    constexpr std::size_t kAround = 2205;
    constexpr std::size_t kCompared = 400;
    double best = 1e9;
    std::size_t found = 0;
    for (std::size_t at = place - kAround; at < place + kAround; ++at) {
        double sum = 0;
        for (std::size_t i = 0; i < 2 * kCompared; ++i)
            sum += std::abs(static_cast<double>(piece[i]) - all[2 * at + i]);
        if (sum < best) found = at;
        best = std::min(best, sum);
    }
    return found;
}

void Seek(benchmark::State& state) {
    const QString path = Path(static_cast<std::size_t>(state.range(0)));
    FFmpegSource source(path, FFmpegFile::LengthBy::Counting, kRate);
    Samples all(2 * static_cast<std::size_t>(source.Length()));
    all.resize(2 * source.Read(all.data(), all.size() / 2));

    const auto heard = std::make_shared<Samples>();
    Player player([&](TFSoundOutputTypes) { return std::make_unique<CaptureOutput>(heard); });
    const FSOUND_STREAM stream = player.Start(path);
    player.library.Advance(kFrames);
    std::mt19937 random(2);
    double worst = 0;
    for (auto _ : state) {
        const int target = 1000 + static_cast<int>(random() % 55'000);
        player.library.FSOUND_Stream_SetTime(stream, target);
        player.library.Advance(Mixer::kBlock);
        state.PauseTiming();
        heard->clear();
        player.library.Advance(Mixer::kBlock);
        const std::size_t place = static_cast<std::size_t>(target) * kRate / 1000 + Mixer::kBlock;
        const double error = static_cast<double>(Find(*heard, all, place)) - static_cast<double>(place);
        worst = std::max(worst, std::abs(error) * 1000 / kRate);
        state.ResumeTiming();
    }
    state.counters["worst error, ms"] = worst;
    Name(state);
}

constexpr int kLastFile = static_cast<int>(std::size(kFiles)) - 1;
BENCHMARK(PlayOne)->DenseRange(0, kLastFile)->MeasureProcessCPUTime()->Unit(benchmark::kMillisecond);
BENCHMARK(PlayCrossFade)->DenseRange(0, kLastFile)->MeasureProcessCPUTime()->Unit(benchmark::kMillisecond);
BENCHMARK(RealTimeOne)->DenseRange(0, kLastFile)->Iterations(1)->Unit(benchmark::kMillisecond);
BENCHMARK(RealTimeCrossFade)->DenseRange(0, kLastFile)->Iterations(1)->Unit(benchmark::kMillisecond);
BENCHMARK(RealTimeDecodeOnly)->DenseRange(0, kLastFile)->Iterations(1)->Unit(benchmark::kMillisecond);
BENCHMARK(DecodeOnly)->DenseRange(0, kLastFile)->MeasureProcessCPUTime()->Unit(benchmark::kMillisecond);
BENCHMARK(DecodeByProgram)->DenseRange(0, kLastFile)->Unit(benchmark::kMillisecond)->UseRealTime();
BENCHMARK(OpenToFirstSound)->DenseRange(0, kLastFile)->Unit(benchmark::kMillisecond)->UseRealTime();
BENCHMARK(Seek)->DenseRange(0, kLastFile)->Unit(benchmark::kMillisecond)->UseRealTime()->Iterations(20);

}  // namespace

BENCHMARK_MAIN();
