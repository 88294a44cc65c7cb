#pragma once

#include <QStringList>
#include <atomic>
#include <span>

#include "MusicManagment/playback/fmod/AudioOutput.h"
#include "MusicManagment/playback/fmod/SdlAudio.h"

// A sound card or sound server, through the first of some SDL drivers that can really open a device.
class SdlOutput : public AudioOutput {
 public:
    explicit SdlOutput(QStringList drivers) : drivers_(std::move(drivers)) {}
    ~SdlOutput() override { SdlOutput::Close(); }

    bool Open(int rate, std::size_t frames, Pull pull) override;
    void Start() override;
    void Stop() override;
    // Waits some tenths of a second for what is gliding into silence.
    void Close() override;
    bool Failed() const override;
    bool Replaceable() const override { return true; }

 private:
    bool OpenDevice(int rate, std::size_t frames);
    void Give(std::span<float> stereo);
    void AwaitSilence();

    const QStringList drivers_;
    SdlAudio audio_;
    Pull pull_;
    unsigned device_ = 0;  // 0 = none
    bool started_ = false;
    std::atomic<bool> silent_{true};  // what was given last
};
