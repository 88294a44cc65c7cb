#pragma once

#include "MusicManagment/playback/eldos/PushOutput.h"

// Plays into nothing, in real time by the engine's clock.
class NullPush : public PushOutput {
 public:
    bool Open(int rate, int channels) override;
    bool Queue(std::span<const std::int16_t> samples) override;
    std::size_t Queued() override;
    void Clear() override;
    void SetPaused(bool paused) override;
    void SetGain(float) override {}
    bool Failed() const override { return false; }

 private:
    void PlayUntilNow();

    std::int64_t rate_ = 1;
    std::int64_t frameBytes_ = 1;
    std::int64_t queued_ = 0;  // frames
    qint64 playedUntil_ = 0;   // ticks of the clock
    bool paused_ = true;
};
