// What every engine owes the player: every type of file that its row of the table names, played, sought and
// ended; and its own way to refuse what cannot be played.

#include <gtest/gtest.h>

#include <QTcpServer>
#include <QTemporaryDir>
#include <random>

#include "MusicManagment/playback/mci/MediaAddress.h"
#include "tests/PrintQt.h"
#include "tests/playback/SongFiles.h"
#include "tests/playback/SoundFiles.h"
#include "tests/playback/engines/EngineRigs.h"

using namespace Qt::StringLiterals;

// GLib gives up its table of names on purpose when it grows, so that it can be read without a lock. What Qt
// has queued for its own thread of the bus is lost when the program ends before it is delivered. An object of
// ours that is lost is still told: it is not made within Qt.
extern "C" const char* __lsan_default_suppressions();   // NOLINT(bugprone-reserved-identifier)
extern "C" const char* __lsan_default_suppressions() {  // NOLINT(bugprone-reserved-identifier)
    return "leak:libglib-2.0.so\nleak:libQt6Core.so";
}

namespace {

// A small song of each type, and the engines that play it by their tables.
struct FileType {
    const char* extension;
    std::vector<TEngine> engines;
    void (*Write)(const QString& path);
    quint32 length;      // ms
    quint32 tolerance;   // ms, of the length: encoders put silence around a sound
    quint32 rowsLength;  // ms between the places that a seek in a song of rows can reach; 0 = it has none
};

constexpr quint32 kLength = 2000;

// The FMOD back end counts 144 ms a row.
constexpr quint32 kPattern = 64 * 144;
constexpr quint32 kMidiRow = 144;

void WriteTone(const QString& path) {
    WriteSound(path, Sine({}, kLength / 1000));
}

QByteArray Tune() {
    MidiTrack track;
    for (const int key : {60, 64, 67, 72})
        track.Note(0, key, 480);
    return Midi({track.End(0)});
}

void WriteMidi(const QString& path) {
    WriteBytes(path, path.endsWith(QLatin1StringView("rmi")) ? Rmi(Tune()) : Tune());
}

template <QByteArray (*Make)(const ModuleSong&)>
void WriteModule(const QString& path) {
    WriteBytes(path, Make({}));
}

const std::vector<FileType>& FileTypes() {
    using enum TEngine;
    static const std::vector<FileType> types = {
        {"mp3", {FMOD, EldoS, MCI, WinAmp}, WriteTone, kLength, 60, 0},
        {"mp2", {FMOD, EldoS, MCI}, WriteTone, kLength, 60, 0},
        {"wma", {FMOD, EldoS, MCI}, WriteTone, kLength, 120, 0},
        {"wav", {FMOD, EldoS, MCI}, WriteTone, kLength, 1, 0},
        {"mid", {FMOD, MCI}, WriteMidi, kLength, kMidiRow, kMidiRow},
        {"rmi", {FMOD, MCI}, WriteMidi, kLength, kMidiRow, kMidiRow},
        {"avi", {MCI}, WriteTone, kLength, 20, 0},
        {"asf", {FMOD}, WriteTone, kLength, 120, 0},
        {"ogg", {FMOD}, WriteTone, kLength, 60, 0},
        {"raw", {FMOD}, WriteTone, kLength, 1, 0},
        {"mod", {FMOD}, WriteModule<Mod>, 3 * kPattern, 0, kPattern},
        {"s3m", {FMOD}, WriteModule<S3m>, 3 * kPattern, 0, kPattern},
        {"xm", {FMOD}, WriteModule<Xm>, 3 * kPattern, 0, kPattern},
        {"it", {FMOD}, WriteModule<It>, 3 * kPattern, 0, kPattern},
    };
    return types;
}

constexpr quint32 kSeekTolerance = 60;  // ms
// The system's player goes on while it is asked.
constexpr quint32 kLate = 700;

struct TypeCase {
    TEngine engine;
    const FileType* type;
};

std::vector<TypeCase> TypeCases() {
    std::vector<TypeCase> cases;
    for (const FileType& type : FileTypes())
        for (const TEngine engine : type.engines)
            cases.push_back({engine, &type});
    return cases;
}

class EngineTypes : public testing::TestWithParam<TypeCase> {
 protected:
    void SetUp() override {
        path_ = folder_.filePath(u"Töne #1 100 %."_s + QLatin1StringView(type_.extension));
        ASSERT_EQ(ChooseEngine(path_, Only(GetParam().engine)), GetParam().engine) << "not in its table";
        type_.Write(path_);
        sound_ = rig_->Open(path_);
    }

    bool Reaches(quint32 position) {
        return rig_->Await(*sound_, [&] { return sound_->GetPosition() >= position; });
    }
    // Between the places that a seek can reach.
    quint32 SeekStep() const { return GetParam().engine == TEngine::FMOD ? type_.rowsLength : 0; }

    const FileType& type_ = *GetParam().type;
    QTemporaryDir folder_;
    QString path_;
    std::unique_ptr<EngineRig> rig_ = MakeRig(GetParam().engine);
    std::unique_ptr<TPlaySoundContainer> sound_;
};

TEST_P(EngineTypes, PlayPauseSeekEndAndClose) {
    EXPECT_EQ(sound_->GetStatus(), psStopped);
    EXPECT_EQ(sound_->GetPosition(), 0U);
    sound_->Play();
    EXPECT_EQ(sound_->GetStatus(), psPlaying);
    ASSERT_TRUE(Reaches(144));
    EXPECT_EQ(sound_->GetStatus(), psPlaying);
    // The player of the system has to play some files for a moment before it can tell.
    ASSERT_TRUE(rig_->Await(*sound_, [&] { return sound_->GetLength() > 0; }));
    EXPECT_NEAR(sound_->GetLength(), type_.length, type_.tolerance);
    sound_->PauseResume();
    EXPECT_EQ(sound_->GetStatus(), psPaused);
    sound_->PauseResume();
    EXPECT_EQ(sound_->GetStatus(), psPlaying);

    const quint32 half = type_.length / 2;
    sound_->SetPosition(half);
    const quint32 landed = sound_->GetPosition();
    EXPECT_GE(landed + SeekStep() + kSeekTolerance, half);
    EXPECT_LE(landed, half + (GetParam().engine == TEngine::MCI ? kLate : kSeekTolerance));
    ASSERT_TRUE(Reaches(landed + 1));

    sound_->SetPosition(sound_->GetLength() - 50);
    ASSERT_TRUE(rig_->Await(*sound_, [&] { return sound_->GetStatus() == psStopped; }));
    EXPECT_GE(sound_->GetPosition() + kSeekTolerance, sound_->GetLength());
    EXPECT_NEAR(sound_->GetLength(), type_.length, type_.tolerance);
    sound_->Play();
    EXPECT_EQ(sound_->GetStatus(), psPlaying);
    EXPECT_LT(sound_->GetPosition(), half);

    sound_->Stop();
    EXPECT_EQ(sound_->GetStatus(), psStopped);
    EXPECT_EQ(sound_->GetPosition(), 0U);
    EXPECT_NEAR(sound_->GetLength(), type_.length, type_.tolerance);
    sound_->Close();
    EXPECT_EQ(sound_->GetStatus(), psClosed);
    EXPECT_EQ(sound_->GetPosition() + sound_->GetLength(), 0U);
}

INSTANTIATE_TEST_SUITE_P(Engines, EngineTypes, testing::ValuesIn(TypeCases()), [](const auto& type) {
    return EngineName(type.param.engine).toStdString() + type.param.type->extension;
});

// How the message of an engine begins that cannot open a file.
QString Refused(TEngine engine, const QString& path) {
    switch (engine) {
        case TEngine::FMOD:
            return u"Fehler beim Öffnen der Datei "_s + path + u" in FMOD: "_s;
        case TEngine::EldoS:
            return u"Kann die Datei "_s + path + u" nicht abspielen ("_s;
        default:
            return u"Fehler bei mciSendCommand mit MCI_OPEN.\r\n"_s;
    }
}

QByteArray RandomBytes(qsizetype size) {
    std::mt19937 random(1);  // NOLINT: the same ones each time
    QByteArray bytes(size, '\0');
    for (char& byte : bytes)
        byte = static_cast<char>(random());
    return bytes;
}

class EngineFailures : public testing::TestWithParam<TEngine> {
 protected:
    QString Write(const QString& name, const QByteArray& bytes) const {
        WriteBytes(folder_.filePath(name), bytes);
        return folder_.filePath(name);
    }
    static QStringList Extensions() {
        QStringList extensions;
        for (const FileType& type : FileTypes())
            if (std::ranges::find(type.engines, GetParam()) != type.engines.end())
                extensions << QLatin1StringView(type.extension);
        return extensions;
    }
    void ExpectRefused(const QString& path) {
        const QString message = rig_->Refusal(path);
        const QString begin = Refused(GetParam(), path);
        EXPECT_TRUE(message.startsWith(begin) && message.size() > begin.size())
            << path.toStdString() << ": " << message.toStdString();
    }

    QTemporaryDir folder_;
    std::unique_ptr<EngineRig> rig_ = MakeRig(GetParam());
};

TEST_P(EngineFailures, WhatIsNoSoundIsRefusedInEveryType) {
    for (const QString& extension : Extensions()) {
        ExpectRefused(folder_.filePath(u"fehlt."_s + extension));
        ExpectRefused(Write(u"leer."_s + extension, {}));
        if (extension == u"raw"_s) continue;  // samples without any header: there is nothing that is none
        ExpectRefused(
            Write(u"text."_s + extension, QByteArray("nothing that anybody could play ").repeated(400)));
        ExpectRefused(Write(u"zufall."_s + extension, RandomBytes(20'000)));
    }
}

// Some say so at once, the others play what is there.
TEST_P(EngineFailures, CutOffFilesAreRefusedOrEnd) {
    for (const FileType& type : FileTypes()) {
        const QString extension = QLatin1StringView(type.extension);
        if (!Extensions().contains(extension)) continue;
        SCOPED_TRACE(type.extension);
        const QString path = folder_.filePath(u"ganz."_s + extension);
        type.Write(path);
        const QByteArray whole = ReadBytes(path);
        for (const qsizetype size : {qsizetype{3}, whole.size() / 4}) {
            const QString cut = Write(u"teil."_s + extension, whole.first(size));
            const QString error = rig_->Refusal(cut);
            EXPECT_TRUE(error.isEmpty() || error.startsWith(Refused(GetParam(), cut))) << error.toStdString();
            if (!error.isEmpty()) continue;
            const auto sound = rig_->Open(cut);
            sound->Play();
            EXPECT_TRUE(rig_->Await(*sound, [&] { return sound->GetStatus() == psStopped; }));
            EXPECT_GE(sound->GetPosition() + 120, sound->GetLength());
        }
    }
}

// An engine goes by a file's contents, whatever it is called, and must not follow what stands there.
TEST_P(EngineFailures, NoFileLeadsToTheNetwork) {
    QTcpServer listener;
    ASSERT_TRUE(listener.listen(QHostAddress::LocalHost));
    const QByteArray address = "http://127.0.0.1:" + QByteArray::number(listener.serverPort()) + "/a.mp3";
    const QByteArray lists[] = {
        "#EXTM3U\n#EXT-X-VERSION:3\n#EXT-X-TARGETDURATION:5\n#EXT-X-MEDIA-SEQUENCE:0\n#EXTINF:5,\n" +
            address + "\n#EXT-X-ENDLIST\n",
        "#EXTM3U\n#EXT-X-STREAM-INF:BANDWIDTH=100000\n" + address + "\n",
        "#EXTM3U\n#EXTINF:5,a\n" + address + "\n",
        address + "\n",
        "[playlist]\nFile1=" + address + "\nNumberOfEntries=1\n",
        "[Reference]\nRef1=" + address + "\nRef2=" + address + "\n",
        "ASF " + address,
        "<asx version=\"3.0\"><entry><ref href=\"" + address + "\"/></entry></asx>",
        "<smil><body><audio src=\"" + address + "\"/></body></smil>",
        "<?xml version=\"1.0\"?><MPD xmlns=\"urn:mpeg:dash:schema:mpd:2011\" type=\"static\" "
        "mediaPresentationDuration=\"PT5S\" minBufferTime=\"PT1S\"><Period><AdaptationSet "
        "mimeType=\"audio/mp4\">"
        "<Representation id=\"1\" bandwidth=\"9999\"><BaseURL>" +
            address + "</BaseURL></Representation></AdaptationSet></Period></MPD>",
        "<?xml version=\"1.0\"?><SmoothStreamingMedia MajorVersion=\"2\" MinorVersion=\"0\" "
        "Duration=\"50000000\">"
        "</SmoothStreamingMedia>",
        "v=0\no=- 0 0 IN IP4 127.0.0.1\ns=a\nc=IN IP4 127.0.0.1\nt=0 0\nm=audio " +
            QByteArray::number(listener.serverPort()) + " RTP/AVP/TCP 14\na=control:" + address + "\n",
        "RTSPtextrtsp://127.0.0.1:" + QByteArray::number(listener.serverPort()) + "/a",
        "ffconcat version 1.0\nfile '" + address + "'\n",
    };
    for (const QByteArray& list : lists) {
        for (const QString& extension : {u"mp3"_s, u"wav"_s, u"wma"_s}) {
            ExpectRefused(Write(u"liste."_s + extension, list));
            EXPECT_FALSE(listener.waitForNewConnection(0)) << list.toStdString();
        }
    }
}

// A resampler would work on such a rate for seconds, and on closing as well.
TEST_P(EngineFailures, RatesAndChannelsThatNoSoundHasAreRefused) {
    const QString path = folder_.filePath(u"a.wav"_s);
    for (const auto& [rate, channels] :
         {std::pair(1'260'000'000, 2), std::pair(999, 2), std::pair(44100, 60)}) {
        SCOPED_TRACE(testing::Message() << rate << " Hz, " << channels << " channels");
        WriteWav(path, Sine({}, 0.5), rate, channels);
        ExpectRefused(path);
    }
    WriteWav(path, Sine({}, 0.5), 384'000);
    EXPECT_EQ(rig_->Refusal(path), QString());
}

TEST_P(EngineFailures, WithoutADeviceTheOutputIsToBlame) {
    const QString path = folder_.filePath(u"a.wav"_s);
    WriteWav(path, Sine({}, 0.1));
    const QString reason = GetParam() == TEngine::FMOD
                               ? u"Fehler beim Initialisieren von FMOD: Error initializing output device"_s
                           : GetParam() == TEngine::EldoS
                               ? u"Es gibt keine Tonausgabe, die EldoS verwenden kann."_s
                               : u"Fehler bei mciSendCommand mit MCI_OPEN.\r\nEs gibt keine Tonausgabe."_s;
    EXPECT_EQ(MakeRig(GetParam(), false)->Refusal(path), u"output: "_s + reason);
}

INSTANTIATE_TEST_SUITE_P(Engines, EngineFailures,
                         testing::Values(TEngine::FMOD, TEngine::EldoS, TEngine::MCI),
                         [](const auto& engine) { return EngineName(engine.param).toStdString(); });

TEST(EngineFailuresTest, ATrackOfADiscIsLookedForOnTheDisc) {
    const QTemporaryDir folder;
    const QString path = folder.filePath(u"Track02.cda"_s);
    QByteArray track("RIFF\x24\0\0\0CDDAfmt \x18\0\0\0\x01\0\x02\0", 24);
    track.resize(44, '\0');
    WriteBytes(path, track);
    EXPECT_EQ(MediaAddress(path), "cdda://2");
}

}  // namespace
