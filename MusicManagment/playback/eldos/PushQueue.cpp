#include "MusicManagment/playback/eldos/PushQueue.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace {

std::int16_t ToSample(float value) {
    using Limits = std::numeric_limits<std::int16_t>;
    return static_cast<std::int16_t>(
        std::lrint(std::clamp(value, static_cast<float>(Limits::min()), static_cast<float>(Limits::max()))));
}

}  // namespace

void PushQueue::Reset(int rate, int channels) {
    const float gain = gain_;
    *this = {};
    gain_ = gain;
    channels_ = static_cast<std::size_t>(channels);
    glideFrames_ = GlideFrames(rate);
}

void PushQueue::Queue(std::span<const std::int16_t> samples) {
    queue_.erase(queue_.begin(), queue_.begin() + static_cast<std::ptrdiff_t>(given_));
    given_ = 0;
    queue_.insert(queue_.end(), samples.begin(), samples.end());
}

void PushQueue::Clear() {
    LeaveTail();
    queue_.clear();
    given_ = 0;
    if (fresh_) return;
    level_.Jump(0);
    Aim();
}

// A tail that sounds still goes on below the new one.
void PushQueue::LeaveTail() {
    tail_.erase(tail_.begin(), tail_.begin() + static_cast<std::ptrdiff_t>(tailGiven_));
    tailGiven_ = 0;
    if (fresh_ || level_.Now() == 0) return;
    const std::size_t frames = std::min(glideFrames_, Queued() / channels_);
    tail_.resize(std::max(tail_.size(), frames * channels_));
    Glide out(level_.Now());
    out.To(0, frames);
    for (std::size_t i = 0; i < frames; ++i) {
        const float gain = out.Next();
        for (std::size_t at = i * channels_; at < (i + 1) * channels_; ++at)
            tail_[at] += static_cast<float>(queue_[given_ + at]) * gain;
    }
}

void PushQueue::SetPaused(bool paused) {
    paused_ = paused;
    Aim();
}

void PushQueue::SetGain(float gain) {
    gain_ = gain;
    Aim();
}

void PushQueue::Aim() {
    const float target = paused_ ? 0 : gain_;
    fresh_ ? level_.Jump(target) : level_.To(target, glideFrames_);
}

void PushQueue::Give(std::span<std::int16_t> target) {
    for (std::size_t frame = 0; frame + channels_ <= target.size(); frame += channels_) {
        const bool held = paused_ && level_.Now() == 0;
        const bool sounds = !held && Queued() >= channels_;
        silent_ = sounds || HasTail() ? 0 : silent_ + 1;
        const float gain = level_.Next();
        for (std::int16_t& sample : target.subspan(frame, channels_)) {
            const float song = sounds ? static_cast<float>(queue_[given_++]) * gain : 0;
            sample = ToSample(song + TailSample());
        }
        fresh_ = fresh_ && !sounds;
    }
}
