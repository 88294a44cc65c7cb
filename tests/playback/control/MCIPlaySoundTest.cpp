#include "MusicManagment/playback/mci/MCIPlaySound.h"

#include <gtest/gtest.h>

#include <map>

#include "MusicManagment/playback/backend/EngineErrors.h"
#include "tests/ErrorOf.h"
#include "tests/PrintQt.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

namespace {

// Writes the commands down: "command flags@device".
class ScriptedMci : public MciInterface {
 public:
    QStringList Log;
    MciParameters Last, Opened;
    std::map<MciCommand, quint32> Errors;

    quint32 SendCommand(quint32 device, MciCommand command, quint32 flags,
                        MciParameters& parameters) override {
        Log << u"%1 %2@%3"_s.arg(static_cast<quint32>(command)).arg(flags).arg(device);
        Last = parameters;
        if (command == MciCommand::Open) Opened = parameters;
        parameters.Device = 5;
        return Errors[command];
    }
    QString ErrorString(quint32 error) override { return u"Fehler %1 "_s.arg(error) + QString(200, u'x'); }
};

class MciTest : public testing::Test {
 protected:
    void Open(const QString& name) {
        sound_.SetBackendFile(folder_.Add(name));
        sound_.Open();
    }

    SongFolder folder_;
    ScriptedMci mci_;
    TMCIPlaySound sound_{mci_, folder_.Path(u"settings.conf"_s)};
};

TEST_F(MciTest, ASeekPlaysWhateverItDidBeforeAndADeviceWithoutALoudnessPlaysOn) {
    Open(u"folder/a.mp3"_s);
    EXPECT_EQ(mci_.Opened.Element, u"a.mp3"_s);
    EXPECT_EQ(QDir::currentPath(), folder_.Path(u"folder"_s));
    mci_.Log.clear();
    sound_.SetPosition(5000);
    EXPECT_EQ(mci_.Log, QStringList({u"2055 8@5"_s, u"2054 1@5"_s}));
    mci_.Errors[MciCommand::SetAudio] = 1;
    sound_.SetGain(0.5F);
    EXPECT_EQ(mci_.Last.Value, 500U);
}

TEST_F(MciTest, DeviceTypeGoesByTheExtensionUnlessASettingNamesOne) {
    TRWReg settings(TMCIPlaySound::kExtensionsKey.toString(), folder_.Path(u"settings.conf"_s));
    const std::pair<QString, QString> cases[] = {
        {u"/m/a.WAV"_s, u"waveaudio"_s},
        {u"/m/a.ogg"_s, u"MPEGVideo"_s},
        {u"/m/a"_s, u"MPEGVideo"_s},
    };
    for (const auto& [file, type] : cases)
        EXPECT_EQ(MciDeviceType(file, settings), type) << file.toStdString();
    settings.WriteString(u"MP3"_s, u"MPEGVideo2"_s);
    EXPECT_EQ(MciDeviceType(u"/m/a.mp3"_s, settings), u"MPEGVideo2"_s);
}

TEST_F(MciTest, RefusedCommandsTellTheReason) {
    const auto messageOf = [this](MciCommand command, const std::function<void()>& operation) {
        mci_.Errors = {{command, 263}};
        const QString message = ErrorOf<EMCIException>(operation);
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
    EXPECT_EQ(messageOf(MciCommand::Close, [&] { sound_.Close(); }), QString());
}

}  // namespace
