#include "MusicManagment/playback/eldos/EldoSPlaySound.h"

#include <gtest/gtest.h>

#include <QFile>
#include <QTemporaryDir>
#include <algorithm>
#include <functional>

#include "MusicManagment/playback/eldos/NullPush.h"
#include "MusicManagment/playback/eldos/PushQueue.h"
#include "MusicManagment/playback/eldos/SdlPush.h"
#include "tests/ErrorOf.h"
#include "tests/HandClock.h"
#include "tests/PrintQt.h"
#include "tests/playback/SoundFiles.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kRate = 44100;
// An MP3 encoder leaves itself 5 % of room.
constexpr double kSofter = 0.03;

// Keeps what it is given, and plays when the test says so.
class RecordingOutput : public PushOutput {
 public:
    struct Record {
        Samples samples;  // that were queued
        PushQueue queue;
        int rate = 0;
        int channels = 0;
        float gain = 1;
        bool paused = true;
        bool lost = false;
        bool canOpen = true;
    };

    explicit RecordingOutput(Record& record) : record_(record) {}

    bool Open(int rate, int channels) override {
        record_.queue.Reset(rate, channels);
        record_.rate = rate;
        record_.channels = channels;
        record_.lost = !record_.canOpen;
        return record_.canOpen;
    }
    bool Queue(std::span<const std::int16_t> samples) override {
        Append(record_.samples, samples);
        record_.queue.Queue(samples);
        return true;
    }
    std::size_t Queued() override { return record_.queue.Queued() * sizeof(std::int16_t); }
    void Clear() override { record_.queue.Clear(); }
    void SetPaused(bool paused) override { record_.queue.SetPaused(record_.paused = paused); }
    void SetGain(float gain) override { record_.queue.SetGain(record_.gain = gain); }
    bool Failed() const override { return record_.lost; }

    static void Append(Samples& all, std::span<const std::int16_t> samples) {
        for (const std::int16_t sample : samples)
            all.push_back(static_cast<float>(sample) / 32768);
    }

 private:
    Record& record_;
};

class EldoSTest : public testing::Test {
 protected:
    std::unique_ptr<TEldoSPlaySound> Sound(const QString& path, int bufferCount = 4) {
        settings_.BufferCount = bufferCount;
        settings_.MakeOutput = [this] { return std::make_unique<RecordingOutput>(record_); };
        auto sound = std::make_unique<TEldoSPlaySound>(settings_);
        sound->SetBackendFile(path);
        return sound;
    }
    // A second of 440 Hz, one of 880.
    QString ToneFile(const QString& extension) const {
        const QString path = folder_.filePath(u"Töne."_s + extension);
        Samples tones = Sine({.frequency = 440, .amplitude = 0.5}, 1);
        const Samples second = Sine({.frequency = 880, .amplitude = 0.5}, 1);
        tones.insert(tones.end(), second.begin(), second.end());
        WriteSound(path, tones);
        return path;
    }
    std::size_t Queued() const { return record_.queue.Queued() * sizeof(std::int16_t); }
    // So many bytes are played.
    void Hear(std::size_t bytes) {
        std::vector<std::int16_t> given(bytes / sizeof(std::int16_t));
        record_.queue.Give(given);
        RecordingOutput::Append(heard_, given);
    }
    double Loudness(double frequency, double from, double seconds) const {
        return AmplitudeOf(frequency, record_.samples, static_cast<std::size_t>(from * kRate),
                           static_cast<std::size_t>(seconds * kRate));
    }

    QTemporaryDir folder_;
    TEldoSSettings settings_;
    RecordingOutput::Record record_;
    Samples heard_;
};

class EldoSTypes : public EldoSTest, public testing::WithParamInterface<const char*> {};

TEST_P(EldoSTypes, TheWholeSongIsQueuedAndASeekLandsWhereItShould) {
    const auto sound = Sound(ToneFile(QString::fromLatin1(GetParam())));
    sound->Open();
    EXPECT_EQ(record_.rate, kRate);
    EXPECT_EQ(record_.channels, 2);
    sound->Play();
    while (sound->GetStatus() == psPlaying) {
        Hear(Queued());
        sound->TopUp();
    }
    ASSERT_NEAR(static_cast<double>(record_.samples.size()), 4.0 * kRate, 0.1 * 2 * kRate);
    EXPECT_NEAR(Loudness(440, 0.2, 0.5), 0.5, kSofter);
    EXPECT_LT(Loudness(880, 0.2, 0.5), 0.02);
    EXPECT_NEAR(Loudness(880, 1.2, 0.5), 0.5, kSofter);
    EXPECT_LT(Loudness(440, 1.2, 0.5), 0.02);

    sound->Play();
    record_.samples.clear();
    sound->SetPosition(900);
    EXPECT_EQ(sound->GetPosition(), 900U);
    // The first tone goes on for 100 ms, and for the silence that the encoder began with.
    EXPECT_NEAR(Loudness(440, 0, 0.09), 0.5, 0.05);
    EXPECT_NEAR(Loudness(880, 0.2, 0.1), 0.5, kSofter);
    record_.samples.clear();
    sound->SetPosition(0);
    EXPECT_NEAR(Loudness(440, 0.1, 0.25), 0.5, kSofter);
}

INSTANTIATE_TEST_SUITE_P(Types, EldoSTypes, testing::Values("mp3", "mp2", "wma", "wav"),
                         [](const auto& type) { return std::string(type.param); });

TEST_F(EldoSTest, SoManyBuffersAreKeptQueued) {
    const auto sound = Sound(ToneFile(u"wav"_s), 3);
    sound->SetGain(0.5F);  // nothing is open
    sound->Open();
    sound->SetGain(0.5F);
    EXPECT_EQ(record_.gain, 0.5F);
    EXPECT_EQ(Queued(), 0U);
    sound->Play();
    EXPECT_FALSE(record_.paused);
    EXPECT_EQ(Queued(), std::size_t{3 * 32768});
    EXPECT_EQ(sound->GetPosition(), 0U);

    Hear(30000);  // less than a buffer
    sound->TopUp();
    EXPECT_EQ(Queued(), std::size_t{3 * 32768 - 30000});
    EXPECT_EQ(sound->GetPosition(), 30000U / 4 * 1000 / kRate);
    Hear(10000);
    sound->TopUp();
    EXPECT_EQ(Queued(), std::size_t{4 * 32768 - 40000});

    // Absurd settings are bounded.
    settings_.BufferSize = -1;
    const auto absurd = Sound(sound->BackendFile(), 2000000000);
    absurd->Open();
    absurd->Play();
    EXPECT_EQ(Queued(), std::size_t{64 * 1024});
}

TEST_F(EldoSTest, PositionStandsInPauseAndGoesNoFurtherThanWhatIsQueued) {
    const HandClock clock;
    settings_.MakeOutput = [] { return std::make_unique<NullPush>(); };
    TEldoSPlaySound sound(settings_);
    sound.SetBackendFile(ToneFile(u"wav"_s));
    sound.Open();
    sound.Play();
    clock.Milliseconds += 300;
    sound.PauseResume();
    clock.Milliseconds += 5000;
    EXPECT_EQ(sound.GetPosition(), 300U);
    sound.PauseResume();
    clock.Milliseconds += 200;
    EXPECT_EQ(sound.GetPosition(), 500U);
    sound.Stop();
    // The output ran dry: nobody topped it up for so long.
    sound.Play();
    clock.Milliseconds += 5000;
    EXPECT_EQ(sound.GetPosition(), 743U);
}

TEST_F(EldoSTest, WhateverIsDoneToASongNothingJumps) {
    constexpr Tone kLoud = {.frequency = 100, .amplitude = 0.999};
    const QString path = folder_.filePath(u"a.wav"_s);
    WriteWav(path, Sine(kLoud, 5));
    const auto sound = Sound(path);
    sound->Open();
    using Act = std::function<void()>;
    const Act play = [&] { sound->Play(); };
    const Act stop = [&] { sound->Stop(); };
    const Act pauseOrResume = [&] { sound->PauseResume(); };
    const Act seek = [&] {
        sound->SetPosition(1717);
        sound->SetPosition(2345);
    };
    const Act quieter = [&] { sound->SetGain(0.5F); };
    for (const Act& act : {play, seek, pauseOrResume, pauseOrResume, stop, play, quieter, pauseOrResume, seek,
                           pauseOrResume, stop}) {
        act();
        // From zero to a crest, five periods later.
        for (int block = 0; block < 4; ++block) {
            Hear(std::size_t{4 * 579});
            sound->TopUp();
        }
        const bool silent = sound->GetStatus() != psPlaying;
        EXPECT_EQ(*std::max_element(heard_.end() - 200, heard_.end()) == 0, silent);
    }
    // Two sounds at once, each glides.
    EXPECT_LT(LargestStep(heard_), SteepestStep(kLoud) + 2.0 / static_cast<double>(GlideFrames(kRate)));
}

TEST_F(EldoSTest, ModulesAreLookedForInTheirFolders) {
    const auto opens = [this](const QString& path) {
        const QString error = ErrorOf<EEldoSException>([&] { Sound(path)->Open(); });
        if (error.isEmpty()) return true;
        EXPECT_EQ(error, u"Kann keine zur Datei "_s + path + u" passende EldoS-Sound-DLL finden."_s);
        return false;
    };
    const QString song = ToneFile(u"mp3"_s);
    EXPECT_FALSE(opens(folder_.filePath(u"song.ogg"_s)));
    settings_.ModuleFolders = {folder_.path()};
    EXPECT_FALSE(opens(song));
    WriteBytes(folder_.filePath(u"ELAMP.ESP"_s), "not a library");
    EXPECT_FALSE(opens(song));
    settings_.ModuleFolders += StandardModuleFolders();  // a later one has it
    EXPECT_TRUE(opens(song));
}

TEST_F(EldoSTest, ALostOutputKeepsThePlaceUntilItIsBack) {
    const HandClock clock;
    const auto sound = Sound(ToneFile(u"wav"_s));
    sound->Open();
    sound->Play();
    Hear(44100);  // a quarter of a second was heard
    record_.lost = true;
    record_.canOpen = false;
    sound->TopUp();
    EXPECT_THROW(sound->GetStatus(), EOutputException);
    EXPECT_THROW(sound->Play(), EOutputException);
    EXPECT_EQ(sound->GetPosition(), 250U);
    sound->PauseResume();
    EXPECT_EQ(sound->GetStatus(), psPaused);
    EXPECT_THROW(sound->Play(), EOutputException);

    record_.canOpen = true;
    sound->TopUp();  // not looked for all the time
    EXPECT_THROW(sound->GetStatus(), EOutputException);
    clock.Milliseconds += 5000;
    record_.samples.clear();
    sound->TopUp();
    EXPECT_EQ(sound->GetStatus(), psPlaying);
    EXPECT_FALSE(record_.paused);
    EXPECT_EQ(sound->GetPosition(), 250U);
    EXPECT_NEAR(Loudness(440, 0.3, 0.4), 0.5, kSofter);
    EXPECT_NEAR(static_cast<double>(record_.samples.size()), 4 * 32768 / 2, 1);

    SdlPush never({u"no such driver"_s});
    EXPECT_FALSE(never.Open(44100, 2));
    EXPECT_TRUE(never.Failed());
}

}  // namespace
