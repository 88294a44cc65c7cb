// What the moving spectrum costs: pictures a second of each style, and the processor time of the whole
// program while a song plays, with the spectrum in sight and hidden.

#include <benchmark/benchmark.h>

#include <QApplication>
#include <QEventLoop>
#include <QTemporaryDir>
#include <QTimer>

#include "MusicManagment/playback/fmod/SoundLibrary.h"
#include "MusicManagment/playback/spectrum/SpectrumFeed.h"
#include "app/views/DSPDraw.h"
#include "bench/ProcessorTime.h"
#include "tests/playback/SoundFiles.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kSeconds = 5;
constexpr int kHidden = 3;  // behind the styles

// A song that plays to nobody at the pace of hearing.
class Song {
 public:
    Song() : library(OutputsFor({.kind = OutputChoice::Kind::Null})) {
        const QString path = folder_.filePath(u"a.wav"_s);
        Encode(path, Sweep(kSeconds + 5), {.codec = "pcm_s16le", .format = "wav"});
        library.FSOUND_Init(44100, 32, 2);
        const FSOUND_STREAM stream = library.FSOUND_Stream_OpenFile(path, 0x29);
        library.FSOUND_Stream_PlayEx(stream, FSOUND_FREE, FSOUND_DSPUNIT::kNone, false);
    }
    SpectrumSource Spectrum() {
        return {.SetActive =
                    [this](bool active) {
                        library.FSOUND_DSP_SetActive(library.FSOUND_DSP_GetFFTUnit(), active);
                    },
                .Get = [this] { return library.FSOUND_DSP_GetSpectrum(); }};
    }

 private:
    QTemporaryDir folder_;
    SoundLibrary library;
};

// Lets the window live for a while.
void Wait(int milliseconds) {
    QEventLoop loop;
    QTimer::singleShot(milliseconds, Qt::PreciseTimer, &loop, &QEventLoop::quit);
    loop.exec();
}

void Spectrum(benchmark::State& state) {
    const auto style = static_cast<int>(state.range(0));
    const QString key = u"tunestead spectrum bench"_s;
    Song song;
    SpectrumFeed feed(song.Spectrum(), key);
    TDSPDraw draw(key);
    draw.OnDrawing = [&feed](bool drawing) { drawing ? feed.Start() : feed.Stop(); };
    if (style != kHidden) {
        draw.SetStyle(static_cast<TSpectrumStyle>(style));
        draw.resize(600, 300);
        draw.show();
    }
    Wait(500);
    double spent = 0;
    const int before = draw.Frames();
    for (auto _ : state) {
        const double start = ProcessorTime(RUSAGE_SELF);
        Wait(kSeconds * 1000);
        spent += ProcessorTime(RUSAGE_SELF) - start;
    }
    state.counters["pictures a second"] = static_cast<double>(draw.Frames() - before) / kSeconds;
    state.counters["per cent of a core"] = spent / (10.0 * kSeconds);
    state.SetLabel(style == kHidden ? "hidden" : "600 x 300");
}
BENCHMARK(Spectrum)->DenseRange(ssBars, kHidden)->Iterations(1)->Unit(benchmark::kMillisecond);

}  // namespace

int main(int argc, char** argv) {
    const QApplication application(argc, argv);
    benchmark::Initialize(&argc, argv);
    benchmark::RunSpecifiedBenchmarks();
    return 0;
}
