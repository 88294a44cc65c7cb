#include "MusicManagment/playback/mci/MCIPlaySound.h"

#include <gtest/gtest.h>

#include <map>

#include "MusicManagment/playback/backend/EngineErrors.h"
#include "tests/PrintQt.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

namespace {

// Writes the commands down: "command flags@device".
class ScriptedMci : public MciInterface {
 public:
    QStringList Log;
    MciParameters Last;
    std::map<MciCommand, quint32> Errors;
    std::map<quint32, quint32> Values;  // answers of Status by item

    quint32 SendCommand(quint32 device, MciCommand command, quint32 flags,
                        MciParameters& parameters) override {
        Log << u"%1 %2@%3"_s.arg(static_cast<quint32>(command)).arg(flags).arg(device);
        if (command == MciCommand::Open) parameters.Device = 5;
        if (command == MciCommand::Status) parameters.Value = Values[parameters.Item];
        Last = parameters;
        if (command == MciCommand::Open) opened_ = parameters;
        return Errors[command];
    }
    QString ErrorString(quint32 error) override { return u"Fehler %1 "_s.arg(error) + QString(200, u'x'); }
    const MciParameters& Opened() const { return opened_; }

 private:
    MciParameters opened_;
};

class MciTest : public testing::Test {
 protected:
    void Open(const QString& name) {
        sound_.SetBackendFile(folder_.Add(name));
        sound_.Open();
    }
    void OpenQuietly(const QString& name) {
        Open(name);
        mci_.Log.clear();
    }

    SongFolder folder_;
    ScriptedMci mci_;
    TMCIPlaySound sound_{mci_, folder_.Path(u"settings.conf"_s)};
};

TEST_F(MciTest, OpenNamesTheFileInTheCurrentDirectory) {
    Open(u"folder/a.mp3"_s);
    EXPECT_EQ(mci_.Log, QStringList({u"2051 8704@0"_s, u"2061 1024@5"_s}));
    EXPECT_EQ(mci_.Opened().DeviceType, u"MPEGVideo"_s);
    EXPECT_EQ(mci_.Opened().Element, u"a.mp3"_s);
    EXPECT_EQ(QDir::currentPath(), folder_.Path(u"folder"_s));
    EXPECT_EQ(mci_.Last.TimeFormat, 0U);
}

TEST_F(MciTest, DeviceTypeGoesByTheExtension) {
    const TRWReg none(TMCIPlaySound::kExtensionsKey.toString(), folder_.Path(u"none.conf"_s));
    const std::pair<QString, QString> cases[] = {
        {u"/m/a.WAV"_s, u"waveaudio"_s}, {u"/m/a.cda"_s, u"CDAudio"_s},    {u"/m/a.avi"_s, u"AVIVideo"_s},
        {u"/m/a.mid"_s, u"Sequencer"_s}, {u"/m/a.midi"_s, u"Sequencer"_s}, {u"/m/a.rmi"_s, u"Sequencer"_s},
        {u"/m/a.ogg"_s, u"MPEGVideo"_s}, {u"/m/a"_s, u"MPEGVideo"_s},
    };
    for (const auto& [file, type] : cases)
        EXPECT_EQ(MciDeviceType(file, none), type) << file.toStdString();
}

TEST_F(MciTest, SettingsOverrideTheDeviceType) {
    {
        TRWReg settings(TMCIPlaySound::kExtensionsKey.toString(), folder_.Path(u"settings.conf"_s));
        settings.WriteString(u"MP3"_s, u"MPEGVideo2"_s);
    }
    Open(u"a.mp3"_s);
    EXPECT_EQ(mci_.Opened().DeviceType, u"MPEGVideo2"_s);
    Open(u"b.wav"_s);
    EXPECT_EQ(mci_.Opened().DeviceType, u"waveaudio"_s);
}

TEST_F(MciTest, OperationsAreCommands) {
    OpenQuietly(u"a.mp3"_s);
    sound_.Play();
    sound_.Stop();
    EXPECT_EQ(std::exchange(mci_.Log, {}), QStringList({u"2054 1@5"_s, u"2056 0@5"_s, u"2055 256@5"_s}));
    mci_.Values = {{1, 180'000}, {2, 1234}};
    EXPECT_EQ(sound_.GetLength(), 180'000U);
    EXPECT_EQ(sound_.GetPosition(), 1234U);
    EXPECT_EQ(std::exchange(mci_.Log, {}), QStringList({u"2068 256@5"_s, u"2068 256@5"_s}));
    sound_.Close();
    sound_.Close();
    EXPECT_EQ(mci_.Log, QStringList({u"2052 0@5"_s}));
}

TEST_F(MciTest, ADeviceWithoutVolumePlaysOn) {
    sound_.SetGain(0.5F);  // nothing is open
    EXPECT_TRUE(mci_.Log.isEmpty());
    OpenQuietly(u"a.mp3"_s);
    mci_.Errors[MciCommand::SetAudio] = 1;
    sound_.SetGain(0.5F);
    EXPECT_EQ(mci_.Log, QStringList({u"2163 25165824@5"_s}));
    EXPECT_EQ(mci_.Last.Item, 0x4002U);
    EXPECT_EQ(mci_.Last.Value, 500U);
}

TEST_F(MciTest, SeekingPlaysWhateverItDidBefore) {
    OpenQuietly(u"a.mp3"_s);
    mci_.Values[4] = 529;
    sound_.SetPosition(5000);
    EXPECT_EQ(mci_.Log, QStringList({u"2055 8@5"_s, u"2054 1@5"_s}));
}

TEST_F(MciTest, PauseResumesThroughPlay) {
    OpenQuietly(u"a.mp3"_s);
    mci_.Values[4] = 526;
    sound_.PauseResume();
    EXPECT_EQ(mci_.Log.last(), u"2057 0@5"_s);
    mci_.Values[4] = 529;
    sound_.PauseResume();
    EXPECT_EQ(mci_.Log.last(), u"2054 1@5"_s);
}

TEST_F(MciTest, ModesBecomeStatuses) {
    OpenQuietly(u"a.mp3"_s);
    const std::pair<quint32, TPSStatus> cases[] = {{524, psClosed},  {525, psStopped}, {526, psPlaying},
                                                   {527, psClosed},  {528, psSeeking}, {529, psPaused},
                                                   {530, psOpening}, {0, psClosed}};
    for (const auto& [mode, status] : cases) {
        mci_.Values[4] = mode;
        EXPECT_EQ(sound_.GetStatus(), status) << mode;
    }
}

TEST_F(MciTest, WithoutADeviceNothingIsAsked) {
    EXPECT_EQ(sound_.GetStatus(), psClosed);
    EXPECT_EQ(sound_.GetPosition() + sound_.GetLength(), 0U);
    sound_.Close();
    EXPECT_TRUE(mci_.Log.isEmpty());
}

TEST_F(MciTest, RefusedCommandsTellTheReason) {
    const auto messageOf = [this](MciCommand command, const std::function<void()>& operation) {
        mci_.Errors = {{command, 263}};
        QString message;
        try {
            operation();
        } catch (const EMCIException& error) {
            message = error.Message();
        }
        mci_.Errors.clear();
        return message;
    };
    const QString reason = (u"Fehler 263 "_s + QString(200, u'x')).left(128);
    const QString prefix = u"Fehler bei mciSendCommand mit "_s;
    EXPECT_EQ(messageOf(MciCommand::Open, [&] { Open(u"a.mp3"_s); }), prefix + u"MCI_OPEN.\r\n"_s + reason);
    EXPECT_EQ(sound_.GetStatus(), psClosed);
    EXPECT_EQ(messageOf(MciCommand::Set, [&] { Open(u"a.mp3"_s); }), prefix + u"MCI_SET:\r\n"_s + reason);
    Open(u"a.mp3"_s);
    EXPECT_EQ(messageOf(MciCommand::Play, [&] { sound_.Play(); }), prefix + u"MCI_PLAY:\r\n"_s + reason);
    EXPECT_EQ(messageOf(MciCommand::Stop, [&] { sound_.Stop(); }), prefix + u"MCI_STOP:\r\n"_s + reason);
    EXPECT_EQ(messageOf(MciCommand::Seek, [&] { sound_.Stop(); }), prefix + u"MCI_SEEK:\r\n"_s + reason);
    EXPECT_EQ(messageOf(MciCommand::Seek, [&] { sound_.SetPosition(1); }),
              prefix + u"MCI_SEEK:\r\n"_s + reason);
    EXPECT_EQ(messageOf(MciCommand::Pause, [&] { sound_.PauseResume(); }),
              prefix + u"MCI_PAUSE:\r\n"_s + reason);
    EXPECT_EQ(messageOf(MciCommand::Status, [&] { sound_.GetLength(); }),
              prefix + u"MCI_STATUS:\r\n"_s + reason);
    EXPECT_EQ(messageOf(MciCommand::Close, [&] { sound_.Close(); }), QString());
}

}  // namespace
