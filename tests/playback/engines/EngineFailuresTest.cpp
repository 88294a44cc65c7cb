// Each engine's own way to refuse: files that are missing or damaged, types it does not know, no device.

#include <gtest/gtest.h>

#include <QTemporaryDir>
#include <random>

#include "MusicManagment/playback/mci/MediaAddress.h"
#include "tests/PrintQt.h"
#include "tests/playback/SoundFiles.h"
#include "tests/playback/engines/EngineRigs.h"
#include "tests/playback/engines/TypeFiles.h"

using namespace Qt::StringLiterals;

namespace {

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
    QString Path(const QString& name) const { return folder_.filePath(name); }
    QString Write(const QString& name, const QByteArray& bytes) const {
        WriteBytes(Path(name), bytes);
        return Path(name);
    }
    static QStringList Extensions() {
        QStringList extensions;
        for (const FileType& type : FileTypes()) {
            const QString extension = QLatin1StringView(type.extension);
            if (ChooseEngine(u"/x."_s + extension, Only(GetParam()))) extensions << extension;
        }
        return extensions;
    }
    // The reason behind the beginning that is expected; fails without one.
    QString ReasonFor(const QString& path) {
        const QString message = rig_->Refusal(path);
        const QString begin = Refused(GetParam(), path);
        EXPECT_TRUE(message.startsWith(begin)) << path.toStdString() << ": " << message.toStdString();
        EXPECT_GT(message.size(), begin.size());
        return message.mid(begin.size());
    }

    QTemporaryDir folder_;
    std::unique_ptr<EngineRig> rig_ = MakeRig(GetParam());
};

TEST_P(EngineFailures, MissingAndEmptyFilesAreRefusedInEveryType) {
    for (const QString& extension : Extensions()) {
        const QString missing = ReasonFor(Path(u"fehlt."_s + extension));
        const QString empty = ReasonFor(Write(u"leer."_s + extension, {}));
        if (GetParam() != TEngine::FMOD) continue;
        EXPECT_EQ(missing, u"File not found"_s);
        EXPECT_EQ(empty, u"Unknown file format"_s) << extension.toStdString();
    }
}

TEST_P(EngineFailures, FilesOfAnythingElseAreRefusedInEveryType) {
    for (const QString& extension : Extensions()) {
        if (extension == u"raw"_s) continue;  // samples without any header: there is nothing that is none
        ReasonFor(
            Write(u"text."_s + extension, QByteArray("nothing that anybody could play ").repeated(400)));
        ReasonFor(Write(u"zufall."_s + extension, RandomBytes(20'000)));
        ReasonFor(Write(u"anfang."_s + extension, RandomBytes(3)));
    }
}

// Some say so at once, the others play what is there.
TEST_P(EngineFailures, CutOffFilesAreRefusedOrEnd) {
    for (const QString& extension : Extensions()) {
        SCOPED_TRACE(extension.toStdString());
        const QString path = Path(u"ganz."_s + extension);
        FileTypeOf(extension).Write(path);
        const QByteArray whole = ReadBytes(path);
        for (const qsizetype size : {qsizetype{3}, whole.size() / 4}) {
            const QString cut = Write(u"teil."_s + extension, whole.first(size));
            const auto sound = rig_->Make();
            sound->SetBackendFile(cut);
            const QString error = rig_->OpenError(*sound);
            if (!error.isEmpty()) {
                EXPECT_TRUE(error.startsWith(Refused(GetParam(), cut))) << error.toStdString();
                continue;
            }
            sound->Play();
            EXPECT_TRUE(rig_->Await(*sound, [&] { return sound->GetStatus() == psStopped; }));
            EXPECT_GE(sound->GetPosition() + 120, sound->GetLength());
        }
    }
}

TEST_P(EngineFailures, UnknownTypesAreRefused) {
    const QString path = Write(u"brief.txt"_s, "Sehr geehrte Damen und Herren");
    EXPECT_FALSE(ChooseEngine(path, Only(GetParam())));
    const QString message = rig_->Refusal(path);
    if (GetParam() == TEngine::EldoS)
        EXPECT_EQ(message, u"Kann keine zur Datei "_s + path + u" passende EldoS-Sound-DLL finden."_s);
    else
        EXPECT_TRUE(message.startsWith(Refused(GetParam(), path))) << message.toStdString();
}

INSTANTIATE_TEST_SUITE_P(Engines, EngineFailures,
                         testing::Values(TEngine::FMOD, TEngine::EldoS, TEngine::MCI),
                         [](const auto& engine) { return EngineName(engine.param).toStdString(); });

TEST(EngineFailuresTest, WithoutADeviceNothingIsOpened) {
    const QTemporaryDir folder;
    const QString path = folder.filePath(u"a.wav"_s);
    WriteWav(path, Sine({}, 0.1));
    EXPECT_EQ(MakeRig(TEngine::FMOD, false)->Refusal(path),
              u"Fehler beim Initialisieren von FMOD: Error initializing output device"_s);
    EXPECT_EQ(MakeRig(TEngine::EldoS, false)->Refusal(path),
              u"Es gibt keine Tonausgabe, die EldoS verwenden kann."_s);
    EXPECT_EQ(MakeRig(TEngine::MCI, false)->Refusal(path),
              u"Fehler bei mciSendCommand mit MCI_OPEN.\r\nEs gibt keine Tonausgabe."_s);
}

TEST(EngineFailuresTest, ATrackOfADiscNeedsTheDisc) {
    const QTemporaryDir folder;
    const QString path = folder.filePath(u"Track02.cda"_s);
    QByteArray track("RIFF\x24\0\0\0CDDAfmt \x18\0\0\0\x01\0\x02\0", 24);
    track.resize(44, '\0');
    WriteBytes(path, track);
    EXPECT_EQ(ChooseEngine(path, {}), TEngine::MCI);
    EXPECT_EQ(MediaAddress(path), "cdda://2");
    // Hardly a machine for tests has a drive, let alone a disc in it.
    const QString message = MakeRig(TEngine::MCI)->Refusal(path);
    EXPECT_TRUE(message.isEmpty() || message.startsWith(Refused(TEngine::MCI, path)))
        << message.toStdString();
}

}  // namespace
