#pragma once

#include "CommonRUKTools/RWReg.h"
#include "MusicManagment/playback/backend/GainBackend.h"
#include "MusicManagment/playback/mci/MciInterface.h"

// The kind of device that plays files with this name: what the settings say under its extension ("MP3"), or
// else what is built in.
QString MciDeviceType(const QString& fileName, const TRWReg& extensions);

// A song that the system's own player plays. Every operation throws EMCIException when it refuses. Open, Play
// and GetStatus throw EOutputException when there is no output, or it has been lost while the song plays;
// Play then goes on where it was as soon as there is one again.
class TMCIPlaySound : public TPlaySoundContainer, public GainBackend {
 public:
    // Where the settings keep device types by extension.
    static constexpr QStringView kExtensionsKey = u"\\Software\\RUK\\Tunestead3\\mci extensions";

    // The interface must outlive the back end. `settingsFile` is where the settings lie.
    explicit TMCIPlaySound(MciInterface& mci, QString settingsFile = TRWReg::DefaultFile(),
                           QObject* parent = nullptr);
    ~TMCIPlaySound() override;

    // Makes the file's folder the current directory of the process: devices take bare file names.
    void Open() override;
    void Close() override;
    void Play() override;
    void Stop() override;
    void PauseResume() override;
    quint32 GetPosition() override;
    // Goes on playing from there, whatever it did before.
    void SetPosition(quint32 milliseconds) override;
    quint32 GetLength() override;
    TPSStatus GetStatus() override;
    void SetGain(float gain) override;

 private:
    void Send(MciCommand command, quint32 flags, MciParameters parameters = {});
    quint32 Ask(quint32 item);
    bool IsPaused();
    MciParameters Require(MciCommand command, quint32 flags, MciParameters parameters);

    MciInterface& mci_;
    QString settingsFile_;
    quint32 device_ = 0;  // 0 none is open
};
