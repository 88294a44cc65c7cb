// convert_bench [SONGS [SECONDS]]: makes MP3 files of WAV files (100 of 60 seconds), as many at a time as the
// machine has cores, beside the ffmpeg program, called once a song as a script would do it, with the same
// encoder, bit rate and effort. Both begin with files in the page cache; the better of two rounds each.

#include <QCoreApplication>
#include <QElapsedTimer>
#include <QFile>
#include <QProcess>
#include <QTemporaryDir>
#include <QThread>
#include <algorithm>
#include <cstdio>
#include <random>
#include <stdexcept>

#include "MusicManagment/conversion/ConversionRun.h"
#include "tests/playback/SoundFiles.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kRounds = 2;
constexpr int kBitRate = 192;  // kbit/s
constexpr int kEffort = 5;     // the one that ffmpeg chooses

// Two voices with noise: something for an encoder to do.
Samples Music(double seconds) {
    Samples samples = Sweep(seconds);
    std::mt19937 random(1);
    std::uniform_real_distribution<float> noise(-0.1F, 0.1F);
    for (float& sample : samples)
        sample = 0.6F * sample + noise(random);
    return samples;
}

double SecondsOf(const std::function<void()>& work) {
    QElapsedTimer clock;
    clock.start();
    work();
    return static_cast<double>(clock.nsecsElapsed()) / 1e9;
}

void ConvertOurs(const QStringList& songs, const QString& folder) {
    EncoderSettings settings;
    settings.Mp3 = {.Bits = Mp3Settings::Method::Constant, .BitRate = kBitRate, .Effort = kEffort};
    std::vector<ConversionJob> jobs;
    for (const QString& song : songs) {
        ConversionJob job{.Source = song};
        job.Target = folder + u'/' + QString::number(jobs.size()) + u".mp3"_s;
        job.Record.Title = u"Titel"_s;
        jobs.push_back(std::move(job));
    }
    for (const auto& outcome : RunConversions(jobs, settings, [](const ConversionState&) { return true; }))
        if (!outcome.Done) throw std::runtime_error(outcome.Error.toStdString());
}

void ConvertTheirs(const QStringList& songs, const QString& folder) {
    for (qsizetype i = 0; i < songs.size(); ++i) {
        const QString target = folder + u'/' + QString::number(i) + u".mp3"_s;
        const int result = QProcess::execute(
            u"ffmpeg"_s, {u"-nostdin"_s, u"-loglevel"_s, u"error"_s, u"-i"_s, songs[i], u"-b:a"_s,
                          QString::number(kBitRate) + u'k', u"-metadata"_s, u"title=Titel"_s, target});
        if (result != 0) throw std::runtime_error("ffmpeg failed");
    }
}

double BestOf(const QStringList& songs, void (*convert)(const QStringList&, const QString&)) {
    double best = 0;
    for (int round = 0; round < kRounds; ++round) {
        const QTemporaryDir folder;
        const double seconds = SecondsOf([&] { convert(songs, folder.path()); });
        best = round == 0 ? seconds : std::min(best, seconds);
    }
    return best;
}

}  // namespace

int main(int argc, char** argv) {
    const QCoreApplication application(argc, argv);
    const int count = argc > 1 ? std::atoi(argv[1]) : 100;
    const double seconds = argc > 2 ? std::atof(argv[2]) : 60;
    const QTemporaryDir folder;
    QStringList songs = {folder.filePath(u"0.wav"_s)};
    WriteWav(songs[0], Music(seconds));
    for (int i = 1; i < count; ++i) {
        songs << folder.filePath(QString::number(i) + u".wav"_s);
        QFile::copy(songs[0], songs.back());
    }
    const double ours = BestOf(songs, ConvertOurs);
    const double theirs = BestOf(songs, ConvertTheirs);
    std::printf("%d songs of %.0f s to MP3 on %d cores: ours %.1f s, ffmpeg once a song %.1f s, ratio %.2f\n",
                count, seconds, QThread::idealThreadCount(), ours, theirs, ours / theirs);
    return 0;
}
