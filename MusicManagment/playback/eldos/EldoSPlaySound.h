#pragma once

#include <QStringList>
#include <QTimer>
#include <memory>
#include <vector>

#include "MusicManagment/playback/backend/EngineErrors.h"
#include "MusicManagment/playback/backend/GainBackend.h"
#include "MusicManagment/playback/eldos/ModuleFiles.h"
#include "MusicManagment/playback/eldos/PushOutput.h"

class EldoSSound;

// How the engine plays, copied when a back end is made.
struct TEldoSSettings {
    int BufferCount = 4;     // 2 to 64
    int BufferSize = 32768;  // bytes, 1024 to 1048576; other values go to the nearer end
    QStringList ModuleFolders = StandardModuleFolders();
    PushOutputMaker MakeOutput = PushOutputOfEnvironment;
};

// A song in the light engine: a module decodes its type, and a few buffers ahead of what is heard are kept
// queued in an output of its own.
class TEldoSPlaySound : public TPlaySoundContainer, public GainBackend {
 public:
    explicit TEldoSPlaySound(const TEldoSSettings& settings = {}, QObject* parent = nullptr);
    ~TEldoSPlaySound() override;

    // These throw EEldoSException, Open and Play also EOutputException when there is no output. One that is
    // lost while the song plays is looked for again every few seconds; Play and GetStatus throw
    // EOutputException until it is back, and the song stays where it was.
    void Open() override;
    void Play() override;
    void SetPosition(quint32 milliseconds) override;
    void Stop() override;
    TPSStatus GetStatus() override;

    void Close() override;
    void PauseResume() override;
    quint32 GetPosition() override;
    quint32 GetLength() override;
    void SetGain(float gain) override;

    // Queues what has been played since; a timer calls it often enough while the song plays.
    void TopUp();

 private:
    void SeekTo(std::int64_t frame);
    void QueueBuffer();
    void SetPlaying(bool playing);
    void NoticeLoss();
    void Recover();
    bool IsSilenced() const { return outputLost_ && status_ == psPlaying; }
    std::int64_t PlayedFrames();
    quint32 ToMilliseconds(std::int64_t frames) const;

    const TEldoSSettings settings_;
    std::unique_ptr<EldoSSound> sound_;
    std::unique_ptr<PushOutput> output_;
    std::vector<std::int16_t> buffer_;
    QTimer timer_;
    TPSStatus status_ = psClosed;
    std::int64_t pushed_ = 0;  // frames of the song up to the last one queued
    std::int64_t length_ = 0;  // frames; 0 when not known
    bool atEnd_ = false;       // everything has been queued
    bool outputLost_ = false;
    qint64 nextLook_ = 0;  // for a lost output; ticks of the clock
};
