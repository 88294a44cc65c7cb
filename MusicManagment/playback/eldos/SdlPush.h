#pragma once

#include <QStringList>

#include "MusicManagment/playback/eldos/PushOutput.h"
#include "MusicManagment/playback/eldos/PushQueue.h"
#include "MusicManagment/playback/fmod/SdlAudio.h"

// A sound card or sound server, through the first of some SDL drivers that can really open a device.
class SdlPush : public PushOutput {
 public:
    explicit SdlPush(QStringList drivers) : drivers_(std::move(drivers)) {}
    ~SdlPush() override { Close(); }

    bool Open(int rate, int channels) override;
    bool Queue(std::span<const std::int16_t> samples) override;
    std::size_t Queued() override;
    void Clear() override;
    void SetPaused(bool paused) override;
    void SetGain(float gain) override;
    bool Failed() const override;

 private:
    static void Fill(void* self, unsigned char* target, int bytes);
    bool IsSilent();
    void AwaitSilence();
    void Close();

    const QStringList drivers_;
    SdlAudio audio_;
    unsigned device_ = 0;      // 0 = none
    std::size_t silence_ = 0;  // frames that a device is given before it is closed
    PushQueue queue_;          // under the lock of the device
};
