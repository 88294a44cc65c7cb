#include "MusicManagment/playback/eldos/NullPush.h"

#include <algorithm>

#include "CommonRUKTools/Clock.h"

bool NullPush::Open(int rate, int channels) {
    rate_ = rate;
    frameBytes_ = static_cast<std::int64_t>(sizeof(std::int16_t)) * channels;
    queued_ = 0;
    paused_ = true;
    return true;
}

bool NullPush::Queue(std::span<const std::int16_t> samples) {
    PlayUntilNow();
    queued_ += static_cast<std::int64_t>(samples.size_bytes()) / frameBytes_;
    return true;
}

std::size_t NullPush::Queued() {
    PlayUntilNow();
    return static_cast<std::size_t>(queued_ * frameBytes_);
}

void NullPush::Clear() {
    queued_ = 0;
    playedUntil_ = CurrentClock().Ticks();
}

void NullPush::SetPaused(bool paused) {
    PlayUntilNow();
    paused_ = paused;
    playedUntil_ = CurrentClock().Ticks();
}

// Moves on by whole frames only, so that no fraction is lost however often it is asked. Time without anything
// queued is not made up for.
void NullPush::PlayUntilNow() {
    if (paused_) return;
    const qint64 now = CurrentClock().Ticks();
    const std::int64_t due = (now - playedUntil_) * rate_ / 1000;
    if (due >= queued_) {
        queued_ = 0;
        playedUntil_ = now;
        return;
    }
    queued_ -= due;
    playedUntil_ += due * 1000 / rate_;
}
