#include "MusicManagment/conversion/ConvertSong.h"

#include <cmath>

#include "CommonRUKTools/FileChange.h"
#include "MusicManagment/conversion/ConversionTargets.h"
#include "MusicManagment/conversion/PartialFile.h"
#include "MusicManagment/conversion/SongEncoder.h"
#include "ReadMPEGHeader/TagWriting.h"
#include "ReadMPEGHeader/id3v2/CoverArt.h"
#include "tests/StepGate.h"
#include "tests/conversion/ConversionRig.h"
#include "tests/playback/SongFiles.h"

using namespace Qt::StringLiterals;

namespace {

class ConvertSongTest : public ConversionRig {
 protected:
    // A file of every kind that the player decodes. Returns their names.
    QStringList PutEveryKind() const {
        QStringList names;
        for (const char* kind : {"mp3", "mp2", "wma", "asf", "ogg", "wav", "raw", "avi"})
            Sound(names.emplace_back(u"ton."_s + QLatin1StringView(kind)));
        const ModuleSong song{.orders = {0}, .rows = {64}};
        const QByteArray midi = Midi({MidiTrack().Note(0, 60, 480).End(0)});
        const std::pair<QString, QByteArray> notes[] = {
            {u"noten.mod"_s, Mod(song)}, {u"noten.s3m"_s, S3m(song)}, {u"noten.xm"_s, Xm(song)},
            {u"noten.it"_s, It(song)},   {u"noten.mid"_s, midi},      {u"noten.rmi"_s, Rmi(midi)},
            {u"midi.wav"_s, midi}};
        for (const auto& [name, bytes] : notes) {
            folder_.Put(name, bytes);
            names << name;
        }
        return names;
    }
};

double Energy(const Samples& samples) {
    double sum = 0;
    for (const float sample : samples)
        sum += static_cast<double>(sample) * sample;
    return sum;
}

std::int64_t FrameOf(MusicFormat format) {
    return format == MusicFormat::Mp3 ? 1152 : format == MusicFormat::Wma ? 2048 : 0;
}

}  // namespace

TEST_F(ConvertSongTest, EveryKindBecomesEveryFormatAsLongAsLoudAndWithItsTags) {
    for (const QString& name : PutEveryKind()) {
        for (const MusicFormat format : kMusicFormats) {
            SCOPED_TRACE(name.toStdString() + " to " + NameOf(format).toStdString());
            ConversionJob job = Job(name, format);
            job.Record.Artist = u"Ünïted ♫"_s;
            job.Record.Album = u"Album"_s;
            job.Record.Year = u"1999"_s;
            job.Record.Comment = u"Kommentar"_s;
            job.Record.Track = 7;
            job.Record.Genre = 17;
            const TID3Tag made = Convert(job);
            EXPECT_EQ(made.Title, job.Record.Title);
            EXPECT_EQ(made.Artist, job.Record.Artist);
            EXPECT_EQ(made.Album, job.Record.Album);
            EXPECT_EQ(made.Year, job.Record.Year);
            EXPECT_EQ(made.Comment, job.Record.Comment);
            EXPECT_EQ(made.Track, 7);
            EXPECT_EQ(made.Genre, 17);
            const Samples before = Decoded(job.Source, 44100);
            const Samples after = Decoded(job.Target, 44100);
            EXPECT_NEAR(static_cast<double>(after.size()), static_cast<double>(before.size()),
                        static_cast<double>(2 * FrameOf(format)));
            // A part of a frame may be missing.
            constexpr double kLoudestFrame = 0.4 * 0.4;
            EXPECT_NEAR(Energy(after), Energy(before),
                        0.05 * Energy(before) + 0.1 + static_cast<double>(FrameOf(format)) * kLoudestFrame);
        }
    }
}

TEST_F(ConvertSongTest, ChosenRatesSidesAndBitsAreThoseOfTheTarget) {
    WriteWav(folder_.Path(u"hoch.wav"_s), Sine({}, 0.3, 96000), 96000);
    WriteWav(folder_.Path(u"mono.wav"_s), Sine({}, 0.3), 44100, 1);
    const TID3Tag high = Convert(Job(u"hoch.wav"_s, MusicFormat::Mp3));
    EXPECT_EQ(high.SampleRate, 48000);
    EXPECT_EQ(high.ChannelMode, 3);
    EXPECT_EQ(Convert(Job(u"mono.wav"_s, MusicFormat::Mp3)).ChannelMode, 1);
    // Nothing is lost where nothing has to be.
    Convert(Job(u"mono.wav"_s, MusicFormat::Wav));
    EXPECT_EQ(folder_.Get(u"mono.wav.wav"_s).mid(44, 20000), folder_.Get(u"mono.wav"_s).mid(44, 20000));

    settings_.Wav = {.Bits = 24, .Sides = WavSettings::Channels::Mono, .Rate = 22050};
    settings_.Mp3 = {.Bits = Mp3Settings::Method::Constant, .BitRate = 128, .Rate = 32000};
    ConversionJob job = Job(u"hoch.wav"_s, MusicFormat::Wav);
    const TID3Tag wave = Convert(job);
    EXPECT_EQ(wave.SampleRate, 22050);
    EXPECT_EQ(wave.FrameSize, 3);
    EXPECT_NEAR(AmplitudeOf(440, Decoded(job.Target), 1000, 4000, 0, 22050), 0.4, 0.01);
    job.Format = MusicFormat::Mp3;
    job.Target = folder_.Path(u"fest.mp3"_s);
    const TID3Tag constant = Convert(job);
    EXPECT_EQ(constant.SampleRate, 32000);
    EXPECT_EQ(constant.BitRate, 128);
}

TEST_F(ConvertSongTest, WhatIsQuieterThanAStepOfASampleIsStillHeardInTheNoise) {
    const double amplitude = 0.4 / 32768;
    const QString path = folder_.Path(u"leise.wav"_s);
    const Samples quiet = Sine({.amplitude = amplitude}, 1);
    const auto encoder = MakeWaveEncoder(path, {}, {.Rate = 44100});
    encoder->Write(quiet.data(), quiet.size() / 2);
    encoder->Finish();
    EXPECT_NEAR(AmplitudeOf(440, Decoded(path), 0, 44100), amplitude, 0.2 * amplitude);
}

TEST_F(ConvertSongTest, JoinedTracksStayJoinedAndAsLoud) {
    using Method = Mp3Settings::Method;
    const struct {
        Mp3Settings Settings;
        int Rate;
    } cases[] = {{{}, 44100},
                 {{}, 24000},
                 {{.Bits = Method::Constant, .BitRate = 192}, 44100},
                 // Frames without room for what the first one tells.
                 {{.Bits = Method::Constant, .BitRate = 32}, 44100},
                 {{.Bits = Method::Average, .BitRate = 128}, 44100}};
    for (const auto& one : cases) {
        SCOPED_TRACE(testing::Message() << one.Rate << " Hz, " << one.Settings.BitRate << " kbit/s");
        // Each track begins where the other ends.
        const Tone tone{.frequency = one.Rate / 100.0};
        const Samples track = Sine(tone, 0.5, one.Rate);
        WriteWav(folder_.Path(u"a.wav"_s), track, one.Rate);
        settings_.Mp3 = one.Settings;
        const ConversionJob job = Job(u"a.wav"_s, MusicFormat::Mp3);
        Convert(job);
        const Samples heard = Decoded(job.Target);
        QFile::remove(job.Target);
        ASSERT_EQ(heard.size(), track.size());
        Samples joined = heard;
        joined.insert(joined.end(), heard.begin(), heard.end());
        EXPECT_LT(LargestStep(joined, 1000), 1.3 * SteepestStep(tone, one.Rate));
        EXPECT_NEAR(AmplitudeOf(tone.frequency, joined, 2000, 5000, 0, one.Rate), tone.amplitude, 0.005);
    }
}

TEST_F(ConvertSongTest, WindowsMediaBeginsWithTheFirstSample) {
    for (const int rate : {8000, 22050, 44100}) {
        const Samples sweep = Sweep(0.5, rate);
        WriteWav(folder_.Path(u"a.wav"_s), sweep, rate);
        const ConversionJob job = Job(u"a.wav"_s, MusicFormat::Wma);
        Convert(job);
        const Samples heard = Decoded(job.Target);
        QFile::remove(job.Target);
        ASSERT_GE(heard.size(), sweep.size());
        for (std::size_t i = 0; i < 3000; i += 50)
            ASSERT_NEAR(heard[i], sweep[i], 0.05) << rate << " Hz, " << i;
    }
}

TEST_F(ConvertSongTest, CoverAndTrackTotalComeFromTheSource) {
    const QString source = Sound(u"a.mp3"_s);
    const QByteArray picture = "\x89PNG" + QByteArray(3000, 'p');
    {
        FileSource file(source);
        TagEdit edit{.Record = ReadSong(source, {}).Tag, .TrackTotal = 12};
        edit.Cover = CoverPicture{picture, u"image/png"_s};
        const FilePatch patch = PlanTag(file, source, edit, {ReadProfile::Modern});
        const PatchPlan plan = PlanPatch(source, patch, StateOf(source));
        WritePatch(plan);
        FinishPatch(plan);
    }
    for (const MusicFormat format : kMusicFormats) {
        ConversionJob job = Job(u"a.mp3"_s, format);
        job.Record.Track = 3;
        Convert(job);
        FileSource made(job.Target);
        EXPECT_EQ(ReadCoverArt(made), picture) << NameOf(format).toStdString();
        EXPECT_EQ(ReadTrackTotal(made), 12) << NameOf(format).toStdString();
    }
}

TEST_F(ConvertSongTest, WhatTheScriptDoesWrongIsToldAndLeavesNothing) {
    Sound(u"a.wav"_s);
    const QByteArray source = folder_.Get(u"a.wav"_s);
    struct Case {
        QByteArray Lines;
        QString Message;
    };
    const QString late = u"nicht rechtzeitig"_s;
    const Case cases[] = {
        {"echo 'kein Codec' >&2; exit 3", u"(Rückgabewert 3): kein Codec"_s},
        {"exit 0", u"keine Datei geschrieben"_s},
        {"echo halb > \"$2\"; exit 1", u"(Rückgabewert 1)."_s},
        {"echo unsinn > \"$2\"", u"keine Musikdatei"_s},
        {"kill -9 $$", u"gescheitert"_s},
        {"sleep 1000", late},
        {"sleep 1000 & wait", late},
        {"while :; do echo laut; done", late},
        // Half of the sound.
        {"head -c 40000 \"$1\" > \"$2\"", u"Sekunden lang"_s},
    };
    settings_.Wma.TimeLimit = std::chrono::milliseconds(300);
    for (const Case& one : cases) {
        settings_.Script = Script(one.Lines);
        const QString error = ErrorOf([&] { Convert(Job(u"a.wav"_s, MusicFormat::Wma)); });
        EXPECT_FALSE(error.isEmpty()) << one.Lines.constData();
        EXPECT_TRUE(error.contains(one.Message)) << error.toStdString();
        EXPECT_EQ(Files(), (QStringList{u"a.wav"_s, u"skript"_s})) << one.Lines.constData();
    }
    EXPECT_EQ(folder_.Get(u"a.wav"_s), source);
}

TEST_F(ConvertSongTest, TheScriptGetsItsArgumentsWhole) {
    Sound(u"Wer? \"$(da)\" %RATE%.wav"_s);
    settings_.Script = Script("echo \"$1|$3|$4\" > \"${2%/*}/gehoert\"; cat \"$5\" > \"$2\"");
    settings_.ScriptArguments = u"\"zwei Worte\" %TARGET% %RATE% rate=%RATE%% %SOURCE%"_s;
    settings_.Wma.BitRate = 96;
    const ConversionJob job = Job(u"Wer? \"$(da)\" %RATE%.wav"_s, MusicFormat::Wma);
    Convert(job);
    EXPECT_EQ(folder_.Get(u"gehoert"_s), "zwei Worte|96|rate=96%\n");
    EXPECT_TRUE(QFile::exists(job.Target));
}

TEST_F(ConvertSongTest, AFullDiskLeavesTheSourceAndNoHalfTarget) {
    Sound(u"a.wav"_s, 0.1);
    const QByteArray source = folder_.Get(u"a.wav"_s);
    for (const MusicFormat format : {MusicFormat::Mp3, MusicFormat::Wav}) {
        const ConversionJob job = Job(u"a.wav"_s, format);
        int steps = 0;
        {
            const StepGate counting(-1, StepGate::Then::Fails);
            Convert(job);
            steps = counting.Steps;
        }
        ASSERT_GT(steps, 5);
        QFile::remove(job.Target);
        for (int step = 0; step < steps; ++step) {
            const StepGate full(step, StepGate::Then::FailsFromThere);
            const QString error = ErrorOf([&] { Convert(job); });
            // The very last step is after the name.
            if (QFile::remove(job.Target)) continue;
            EXPECT_FALSE(error.isEmpty()) << step;
            EXPECT_EQ(Files(), QStringList{u"a.wav"_s}) << step;
        }
    }
    EXPECT_EQ(folder_.Get(u"a.wav"_s), source);
}

TEST_F(ConvertSongTest, AKillLeavesTheSourceAndWhatTheNextRunSweeps) {
    Sound(u"a.wav"_s, 0.1);
    const QByteArray source = folder_.Get(u"a.wav"_s);
    const ConversionJob job = Job(u"a.wav"_s, MusicFormat::Mp3);
    const auto endAt = [&](int step) {
        const StepGate deadly(step, StepGate::Then::Dies);
        Convert(job);
        std::_Exit(0);
    };
    for (const int step : {0, 1, 3, 5}) {
        EXPECT_EXIT(endAt(step), testing::KilledBySignal(SIGKILL), "") << step;
        EXPECT_FALSE(QFile::exists(job.Target)) << step;
    }
    EXPECT_EQ(folder_.Get(u"a.wav"_s), source);
    const QStringList left = Files();
    EXPECT_GT(left.size(), 1);
    SweepPartialFiles(folder_.Path());
    EXPECT_EQ(Files(), left);  // somebody may be at work on them
    for (const QString& name : left) {
        QFile file(folder_.Path(name));
        ASSERT_TRUE(file.open(QIODevice::ReadWrite));
        file.setFileTime(QDateTime::currentDateTimeUtc().addDays(-1), QFile::FileModificationTime);
    }
    SweepPartialFiles(folder_.Path());
    EXPECT_EQ(Files().filter(u"convert"_s), QStringList());
    EXPECT_TRUE(Files().contains(u"a.wav"_s));
}

TEST_F(ConvertSongTest, AFailedSongDoesNotStopTheOthersAndAStopLeavesNothing) {
    Sound(u"a.wav"_s);
    folder_.Put(u"kaputt.mp3"_s, QByteArray("kein Ton"));
    Sound(u"b.wav"_s);
    folder_.Put(u"b.wav.wav"_s, QByteArray("da"));
    std::vector<ConversionJob> jobs;
    for (const QString& name : {u"a.wav"_s, u"kaputt.mp3"_s, u"b.wav"_s, u"fehlt.mp3"_s})
        jobs.push_back(Job(name, MusicFormat::Wav));
    const auto outcomes = RunConversions(jobs, settings_, [](const ConversionState&) { return true; });
    EXPECT_TRUE(outcomes[0].Done);
    EXPECT_FALSE(outcomes[1].Done || outcomes[2].Done || outcomes[3].Done);
    EXPECT_TRUE(outcomes[1].Error.contains(u"beschädigt"_s));
    EXPECT_TRUE(outcomes[2].Error.contains(u"gibt es schon"_s));
    EXPECT_EQ(folder_.Get(u"b.wav.wav"_s), "da");

    const QStringList before = Files();
    settings_.Script = Script("sleep 1000");
    for (ConversionJob& job : jobs)
        job = Job(u"a.wav"_s, MusicFormat::Wma);
    for (const auto& outcome : RunConversions(jobs, settings_, [](const ConversionState&) { return false; }))
        EXPECT_TRUE(!outcome.Done && outcome.Error.isEmpty());
    EXPECT_EQ(Files(), before + QStringList{u"skript"_s});
}

TEST_F(ConvertSongTest, NamesOfTargetsAreTakenOnce) {
    folder_.Put(u"a.mp3"_s, QByteArray());
    ConversionTargets targets(MusicFormat::Mp3);
    EXPECT_EQ(targets.For(folder_.Path(u"a.wav"_s)), folder_.Path(u"a.mp3"_s));  // which is there: it fails
    EXPECT_EQ(targets.For(folder_.Path(u"a.ogg"_s)), folder_.Path(u"a (2).mp3"_s));
    EXPECT_EQ(targets.For(folder_.Path(u"a.mp3"_s)), folder_.Path(u"a (3).mp3"_s));
    EXPECT_EQ(targets.For(u"/x/b.c/d"_s, u"/ziel"_s), u"/ziel/d.mp3"_s);
    EXPECT_EQ(targets.For(u"/y/d.wav"_s, u"/ziel/"_s), u"/ziel/d (2).mp3"_s);
}
