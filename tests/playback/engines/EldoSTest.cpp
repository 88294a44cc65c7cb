#include "MusicManagment/playback/eldos/EldoSPlaySound.h"

#include <gtest/gtest.h>

#include <QFile>
#include <QTemporaryDir>
#include <cmath>
#include <numbers>

#include "MusicManagment/playback/eldos/NullPush.h"
#include "MusicManagment/playback/eldos/SdlPush.h"
#include "tests/PrintQt.h"
#include "tests/playback/control/PlayerRig.h"
#include "tests/playback/engines/EncodedTone.h"

using namespace Qt::StringLiterals;

namespace {

// An MP3 encoder leaves itself 5 % of room.
constexpr double kSofter = 0.03;

// Keeps what it is given, and plays when the test says so.
class RecordingOutput : public PushOutput {
 public:
    struct Record {
        std::vector<std::int16_t> samples;
        std::size_t queued = 0;  // bytes
        int rate = 0;
        int channels = 0;
        int opened = 0;
        float gain = 1;
        bool paused = true;
        bool lost = false;
        bool canOpen = true;
    };

    explicit RecordingOutput(Record& record) : record_(record) {}

    bool Open(int rate, int channels) override {
        ++record_.opened;
        record_.rate = rate;
        record_.channels = channels;
        record_.queued = 0;
        record_.lost = !record_.canOpen;
        return record_.canOpen;
    }
    bool Queue(std::span<const std::int16_t> samples) override {
        record_.samples.insert(record_.samples.end(), samples.begin(), samples.end());
        record_.queued += samples.size_bytes();
        return true;
    }
    std::size_t Queued() override { return record_.queued; }
    void Clear() override { record_.queued = 0; }
    void SetPaused(bool paused) override { record_.paused = paused; }
    void SetGain(float gain) override { record_.gain = gain; }
    bool Failed() const override { return record_.lost; }

 private:
    Record& record_;
};

// How loud a tone is in interleaved stereo samples: its amplitude in the left channel, 1 is full scale.
double Amplitude(std::span<const std::int16_t> samples, double hertz) {
    double real = 0;
    double imaginary = 0;
    for (std::size_t i = 0; i < samples.size(); i += 2) {
        const double phase = 2 * std::numbers::pi * hertz * static_cast<double>(i / 2) / kToneRate;
        real += samples[i] * std::cos(phase);
        imaginary += samples[i] * std::sin(phase);
    }
    return std::hypot(real, imaginary) * 2 / (32768.0 * static_cast<double>(samples.size() / 2));
}

class EldoSTest : public testing::Test {
 protected:
    std::unique_ptr<TEldoSPlaySound> Sound(const QString& path, int bufferCount = 4) {
        settings_.BufferCount = bufferCount;
        settings_.MakeOutput = [this] { return std::make_unique<RecordingOutput>(record_); };
        auto sound = std::make_unique<TEldoSPlaySound>(settings_);
        sound->SetBackendFile(path);
        return sound;
    }
    QString InFolder(const QString& name) const { return folder_.filePath(name); }
    QString ToneFile(const QString& extension) const {
        const QString path = InFolder(u"Töne."_s + extension);
        WriteTwoTones(path);
        return path;
    }
    QString Write(const QString& name, const QByteArray& contents) const {
        QFile file(InFolder(name));
        EXPECT_TRUE(file.open(QIODevice::WriteOnly));
        file.write(contents);
        return file.fileName();
    }
    static QByteArray Read(const QString& path) {
        QFile file(path);
        EXPECT_TRUE(file.open(QIODevice::ReadOnly));
        return file.readAll();
    }
    // Plays until the song ends by itself, or for an hour.
    void PlayThrough(TEldoSPlaySound& sound) {
        for (int i = 0; i < 100000 && sound.GetStatus() == psPlaying; ++i) {
            record_.queued = 0;
            sound.TopUp();
        }
        EXPECT_EQ(sound.GetStatus(), psStopped);
    }
    QString OpenError(const QString& path) {
        const auto sound = Sound(path);
        try {
            sound->Open();
        } catch (const EEldoSException& error) {
            EXPECT_EQ(sound->GetStatus(), psClosed);
            return error.Message();
        }
        return u"opened"_s;
    }

    QTemporaryDir folder_;
    TEldoSSettings settings_;
    RecordingOutput::Record record_;
};

class EldoSTypes : public EldoSTest, public testing::WithParamInterface<const char*> {};

TEST_P(EldoSTypes, TheWholeSongIsQueuedAndEndsByItself) {
    const auto sound = Sound(ToneFile(QString::fromLatin1(GetParam())));
    sound->Open();
    EXPECT_EQ(sound->GetStatus(), psStopped);
    EXPECT_EQ(record_.rate, kToneRate);
    EXPECT_EQ(record_.channels, 2);
    // Encoders fill up the last frame, and some begin with silence.
    EXPECT_NEAR(sound->GetLength(), 2000, 100);

    sound->Play();
    PlayThrough(*sound);
    EXPECT_EQ(sound->GetPosition(), sound->GetLength());
    const std::span<const std::int16_t> all(record_.samples);
    ASSERT_NEAR(static_cast<double>(all.size()), 4.0 * kToneRate, 0.1 * 2 * kToneRate);
    // The middle of each second, a whole number of periods of both tones.
    const std::span first = all.subspan(std::size_t{kToneRate} / 10 * 4, std::size_t{kToneRate});
    const std::span second = all.subspan(std::size_t{kToneRate} / 10 * 24, std::size_t{kToneRate});
    EXPECT_NEAR(Amplitude(first, kFirstTone), 0.5, kSofter);
    EXPECT_LT(Amplitude(first, kSecondTone), 0.02);
    EXPECT_NEAR(Amplitude(second, kSecondTone), 0.5, kSofter);
    EXPECT_LT(Amplitude(second, kFirstTone), 0.02);
}

TEST_P(EldoSTypes, ASeekLandsWhereItShould) {
    const auto sound = Sound(ToneFile(QString::fromLatin1(GetParam())));
    sound->Open();
    sound->Play();
    record_.samples.clear();
    sound->SetPosition(900);
    EXPECT_EQ(sound->GetPosition(), 900U);
    // The first tone goes on for 100 ms, and for the silence that the encoder began with.
    const std::span<const std::int16_t> after(record_.samples);
    ASSERT_GT(after.size(), std::size_t{kToneRate});
    EXPECT_NEAR(Amplitude(after.first(2 * 4410 * 9 / 10), kFirstTone), 0.5, 0.05);
    EXPECT_NEAR(Amplitude(after.subspan(2 * 4410 * 2, std::size_t{2 * 4410}), kSecondTone), 0.5, kSofter);
    // And back again.
    record_.samples.clear();
    sound->SetPosition(0);
    EXPECT_NEAR(Amplitude(std::span(record_.samples).subspan(8820, std::size_t{kToneRate}), kFirstTone), 0.5,
                kSofter);
}

INSTANTIATE_TEST_SUITE_P(Types, EldoSTypes, testing::Values("mp3", "mp2", "wma", "wav"),
                         [](const auto& type) { return std::string(type.param); });

TEST_F(EldoSTest, SoManyBuffersAreKeptQueued) {
    const auto sound = Sound(ToneFile(u"wav"_s), 3);
    sound->Open();
    EXPECT_EQ(record_.queued, 0U);
    sound->Play();
    EXPECT_FALSE(record_.paused);
    EXPECT_EQ(record_.queued, std::size_t{3 * 32768});
    EXPECT_EQ(sound->GetPosition(), 0U);

    record_.queued -= 30000;  // less than a buffer
    sound->TopUp();
    EXPECT_EQ(record_.queued, std::size_t{3 * 32768 - 30000});
    EXPECT_EQ(sound->GetPosition(), 30000U / 4 * 1000 / kToneRate);
    record_.queued -= 10000;
    sound->TopUp();
    EXPECT_EQ(record_.queued, std::size_t{4 * 32768 - 40000});
    EXPECT_EQ(sound->GetPosition(), 40000U / 4 * 1000 / kToneRate);
}

TEST_F(EldoSTest, AbsurdSettingsOfBuffersAreBounded) {
    settings_.BufferSize = -1;
    const auto sound = Sound(ToneFile(u"wav"_s), 2000000000);
    sound->Open();
    sound->Play();
    EXPECT_EQ(record_.queued, std::size_t{64 * 1024});
}

TEST_F(EldoSTest, PositionFollowsPauseStopAndTheTime) {
    HandClock clock;
    const auto sound = Sound(ToneFile(u"wav"_s));
    settings_.MakeOutput = [] { return std::make_unique<NullPush>(); };
    TEldoSPlaySound timed(settings_);
    timed.SetBackendFile(sound->BackendFile());
    timed.Open();
    clock.Milliseconds += 5000;
    EXPECT_EQ(timed.GetPosition(), 0U);
    timed.Play();
    clock.Milliseconds += 300;
    EXPECT_EQ(timed.GetPosition(), 300U);
    timed.PauseResume();
    EXPECT_EQ(timed.GetStatus(), psPaused);
    clock.Milliseconds += 5000;
    EXPECT_EQ(timed.GetPosition(), 300U);
    timed.PauseResume();
    EXPECT_EQ(timed.GetStatus(), psPlaying);
    clock.Milliseconds += 200;
    EXPECT_EQ(timed.GetPosition(), 500U);
    timed.Stop();
    EXPECT_EQ(timed.GetStatus(), psStopped);
    EXPECT_EQ(timed.GetPosition(), 0U);
    // The output ran dry: nobody topped it up for so long.
    timed.Play();
    clock.Milliseconds += 5000;
    EXPECT_EQ(timed.GetPosition(), 743U);
}

TEST_F(EldoSTest, LoudnessIsThatOfItsOutput) {
    const auto sound = Sound(ToneFile(u".wav"_s));
    sound->SetGain(0.5F);  // nothing is open
    sound->Open();
    sound->SetGain(0.5F);
    EXPECT_EQ(record_.gain, 0.5F);
}

TEST_F(EldoSTest, ASongThatHasEndedBeginsAnew) {
    const auto sound = Sound(ToneFile(u"mp3"_s));
    sound->Open();
    sound->Play();
    sound->SetPosition(999999);
    PlayThrough(*sound);
    EXPECT_EQ(sound->GetPosition(), sound->GetLength());
    sound->Play();
    EXPECT_EQ(sound->GetStatus(), psPlaying);
    EXPECT_EQ(sound->GetPosition(), 0U);
}

TEST_F(EldoSTest, TruncatedFilesEndWhereTheirDataEnd) {
    for (const QString& type : {u"mp3"_s, u"wma"_s, u"wav"_s}) {
        SCOPED_TRACE(type.toStdString());
        const QByteArray whole = Read(ToneFile(type));
        const auto sound = Sound(Write(u"halb."_s + type, whole.first(whole.size() / 2)));
        sound->Open();
        sound->Play();
        PlayThrough(*sound);
        EXPECT_NEAR(sound->GetLength(), 1000, 150);
        EXPECT_EQ(sound->GetPosition(), sound->GetLength());
    }
}

TEST_F(EldoSTest, DamagedFilesAreRefusedByName) {
    const QByteArray junk = QByteArray("nothing that anybody could play ").repeated(400);
    for (const QString& name : {u"a.mp3"_s, u"a.mp2"_s, u"a.wma"_s, u"a.wav"_s}) {
        const QString path = Write(name, junk);
        EXPECT_TRUE(OpenError(path).startsWith(u"Kann die Datei "_s + path + u" nicht abspielen ("_s))
            << OpenError(path).toStdString();
        EXPECT_NE(OpenError(Write(u"leer"_s + name, {})), u"opened"_s);
    }
    // Another sound file under a wrong name.
    QFile::copy(ToneFile(u"mp3"_s), InFolder(u"falsch.wma"_s));
    EXPECT_NE(OpenError(InFolder(u"falsch.wma"_s)), u"opened"_s);
    EXPECT_NE(OpenError(InFolder(u"fehlt.mp3"_s)), u"opened"_s);
}

TEST_F(EldoSTest, WithoutAFittingModuleTheSongIsRefused) {
    const auto refused = [](const QString& path) {
        return u"Kann keine zur Datei "_s + path + u" passende EldoS-Sound-DLL finden."_s;
    };
    const QString ogg = Write(u"song.ogg"_s, "OggS");
    EXPECT_EQ(OpenError(ogg), refused(ogg));

    const QString song = ToneFile(u"mp3"_s);
    settings_.ModuleFolders = {folder_.path()};
    EXPECT_EQ(OpenError(song), refused(song));
    Write(u"ELAMP.ESP"_s, "not a library");
    EXPECT_EQ(OpenError(song), refused(song));
    // A later folder has it.
    settings_.ModuleFolders += StandardModuleFolders();
    EXPECT_EQ(OpenError(song), u"opened"_s);
}

TEST_F(EldoSTest, ALostOutputIsOpenedAgainOrStopsTheSong) {
    const auto sound = Sound(ToneFile(u"wav"_s));
    sound->Open();
    sound->Play();
    record_.lost = true;
    sound->TopUp();
    EXPECT_EQ(record_.opened, 2);
    EXPECT_FALSE(record_.paused);
    EXPECT_EQ(sound->GetStatus(), psPlaying);

    record_.lost = true;
    record_.canOpen = false;
    sound->TopUp();
    EXPECT_EQ(sound->GetStatus(), psStopped);
    const quint32 length = sound->GetLength();
    sound->Play();
    EXPECT_EQ(sound->GetStatus(), psStopped);
    record_.canOpen = true;
    sound->Play();
    EXPECT_EQ(sound->GetStatus(), psPlaying);
    EXPECT_EQ(sound->GetLength(), length);
}

TEST(SdlPushTest, AnOutputThatCannotBeOpenedStaysLost) {
    SdlPush output({u"no such driver"_s});
    EXPECT_FALSE(output.Open(44100, 2));
    EXPECT_TRUE(output.Failed());
}

TEST_F(EldoSTest, WithoutAnOutputNothingIsOpened) {
    record_.canOpen = false;
    EXPECT_EQ(OpenError(ToneFile(u"wav"_s)), u"Es gibt keine Tonausgabe, die EldoS verwenden kann."_s);
}

}  // namespace
