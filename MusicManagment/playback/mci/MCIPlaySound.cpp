#include "MusicManagment/playback/mci/MCIPlaySound.h"

#include <QDir>
#include <QFileInfo>
#include <cmath>
#include <utility>

#include "MusicManagment/playback/backend/EngineErrors.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kLongestError = 128;  // characters

struct DeviceRow {
    QStringView Extension;
    QStringView Device;
};

constexpr DeviceRow kDevices[] = {
    {u"WAV", u"waveaudio"}, {u"CDA", u"CDAudio"},    {u"AVI", u"AVIVideo"},
    {u"MID", u"Sequencer"}, {u"MIDI", u"Sequencer"}, {u"RMI", u"Sequencer"},
};

QString BuiltInDevice(const QString& extension) {
    for (const DeviceRow& row : kDevices)
        if (extension == row.Extension) return row.Device.toString();
    return u"MPEGVideo"_s;
}

struct PrefixRow {
    MciCommand Command;
    QStringView Prefix;
};

constexpr PrefixRow kPrefixes[] = {
    {MciCommand::Open, u"Fehler bei mciSendCommand mit MCI_OPEN.\r\n"},
    {MciCommand::Set, u"Fehler bei mciSendCommand mit MCI_SET:\r\n"},
    {MciCommand::Play, u"Fehler bei mciSendCommand mit MCI_PLAY:\r\n"},
    {MciCommand::Stop, u"Fehler bei mciSendCommand mit MCI_STOP:\r\n"},
    {MciCommand::Seek, u"Fehler bei mciSendCommand mit MCI_SEEK:\r\n"},
    {MciCommand::Pause, u"Fehler bei mciSendCommand mit MCI_PAUSE:\r\n"},
    {MciCommand::Status, u"Fehler bei mciSendCommand mit MCI_STATUS:\r\n"},
};

QString PrefixOf(MciCommand command) {
    for (const PrefixRow& row : kPrefixes)
        if (row.Command == command) return row.Prefix.toString();
    return {};
}

struct StatusRow {
    quint32 Mode;
    TPSStatus Status;
};

// Every other mode (not ready, recording) counts as closed.
constexpr StatusRow kStatuses[] = {
    {kMciModeStop, psStopped}, {kMciModePlay, psPlaying}, {kMciModeSeek, psSeeking},
    {kMciModePause, psPaused}, {kMciModeOpen, psOpening},
};

}  // namespace

QString MciDeviceType(const QString& fileName, const TRWReg& extensions) {
    const QString extension = QFileInfo(fileName).suffix().toUpper();
    if (extension.isEmpty()) return BuiltInDevice(extension);
    return extensions.ReadString(extension).value_or(BuiltInDevice(extension));
}

TMCIPlaySound::TMCIPlaySound(MciInterface& mci, QString settingsFile, QObject* parent)
    : TPlaySoundContainer(parent), mci_(mci), settingsFile_(std::move(settingsFile)) {}

TMCIPlaySound::~TMCIPlaySound() {
    TMCIPlaySound::Close();
}

void TMCIPlaySound::Open() {
    Close();
    const QFileInfo file(BackendFile());
    const TRWReg extensions(kExtensionsKey.toString(), settingsFile_);
    const QString type = MciDeviceType(BackendFile(), extensions);
    QDir::setCurrent(file.absolutePath());
    device_ = Require(MciCommand::Open, kMciOpenTypeElement, {.DeviceType = type, .Element = file.fileName()})
                  .Device;
    Send(MciCommand::Set, kMciSetTimeFormat, {.TimeFormat = kMciFormatMilliseconds});
}

void TMCIPlaySound::Close() {
    if (device_ == 0) return;
    MciParameters parameters;
    mci_.SendCommand(std::exchange(device_, 0), MciCommand::Close, 0, parameters);
}

void TMCIPlaySound::Play() {
    Send(MciCommand::Play, kMciNotify);
}

void TMCIPlaySound::Stop() {
    Send(MciCommand::Stop, 0);
    Send(MciCommand::Seek, kMciSeekToStart);
}

void TMCIPlaySound::PauseResume() {
    if (IsPaused())
        Play();
    else
        Send(MciCommand::Pause, 0);
}

// A song that plays without an output is not.
bool TMCIPlaySound::IsPaused() {
    try {
        return GetStatus() == psPaused;
    } catch (const EOutputException&) {
        return false;
    }
}

quint32 TMCIPlaySound::GetPosition() {
    return Ask(kMciStatusPosition);
}

void TMCIPlaySound::SetPosition(quint32 milliseconds) {
    Send(MciCommand::Seek, kMciTo, {.To = milliseconds});
    Play();
}

quint32 TMCIPlaySound::GetLength() {
    return Ask(kMciStatusLength);
}

TPSStatus TMCIPlaySound::GetStatus() {
    const quint32 mode = Ask(kMciStatusMode);
    for (const StatusRow& row : kStatuses)
        if (row.Mode == mode) return row.Status;
    return psClosed;
}

// Devices for waves and for CDs refuse it.
void TMCIPlaySound::SetGain(float gain) {
    if (device_ == 0) return;
    MciParameters parameters{.Item = kMciAudioVolume,
                             .Value = static_cast<quint32>(std::lround(gain * kMciFullVolume))};
    mci_.SendCommand(device_, MciCommand::SetAudio, kMciSetAudioItem, parameters);
}

void TMCIPlaySound::Send(MciCommand command, quint32 flags, MciParameters parameters) {
    Require(command, flags, std::move(parameters));
}

quint32 TMCIPlaySound::Ask(quint32 item) {
    if (device_ == 0) return 0;
    return Require(MciCommand::Status, kMciStatusItem, {.Item = item}).Value;
}

// Returns the parameters with what the command has answered.
MciParameters TMCIPlaySound::Require(MciCommand command, quint32 flags, MciParameters parameters) {
    const quint32 error = mci_.SendCommand(device_, command, flags, parameters);
    if (error == 0) return parameters;
    const QString message = PrefixOf(command) + mci_.ErrorString(error).left(kLongestError);
    if (error >= kMciErrorFirstOutput && error <= kMciErrorLastOutput) throw EOutputException(message);
    throw EMCIException(message);
}
