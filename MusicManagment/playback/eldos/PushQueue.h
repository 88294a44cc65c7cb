#pragma once

#include <cstdint>
#include <span>
#include <vector>

#include "MusicManagment/playback/backend/Glide.h"

// What stands between an engine that gives samples in advance and a device that asks for them: whatever
// becomes of the queue, nothing jumps in what the device gets. It begins paused; the first sound begins at
// its level, so that nothing of an attack is lost. Not safe for threads.
class PushQueue {
 public:
    // Empty, paused, with the gain that it had. `rate` in Hz.
    void Reset(int rate, int channels);

    void Queue(std::span<const std::int16_t> samples);
    std::size_t Queued() const { return queue_.size() - given_; }  // samples
    // What sounds leaves its next frames, which glide into silence beside what is queued then.
    void Clear();
    void SetPaused(bool paused);
    void SetGain(float gain);  // 0 to 1 of the amplitude
    // Whether nothing has sounded in so many frames that were given last.
    bool WasSilent(std::size_t frames) const { return fresh_ || silent_ >= frames; }

    // Whole frames for the device; silence follows what is queued.
    void Give(std::span<std::int16_t> target);

 private:
    void Aim();
    void LeaveTail();
    bool HasTail() const { return tailGiven_ < tail_.size(); }
    float TailSample() { return HasTail() ? tail_[tailGiven_++] : 0; }

    std::vector<std::int16_t> queue_;
    std::size_t given_ = 0;  // samples at the front of the queue that the device has
    std::vector<float> tail_;
    std::size_t tailGiven_ = 0;
    std::size_t silent_ = 0;  // frames
    std::size_t channels_ = 1;
    std::size_t glideFrames_ = 1;
    Glide level_{0};  // on its way to the gain, or to silence in a pause
    float gain_ = 1;
    bool paused_ = true;
    bool fresh_ = true;  // nothing has sounded yet, so there is nothing to glide from
};
