#include "MusicManagment/playback/fmod/Mixer.h"

#include <algorithm>
#include <limits>
#include <thread>

namespace {

constexpr int kMaxChannels = 1024;
// Channel numbers carry how often channels have been started, so that an old number hits no new sound.
constexpr int kRounds = std::numeric_limits<int>::max() / kMaxChannels;

}  // namespace

Mixer::Mixer(std::size_t channels, int rounds)
    : channels_(std::min<std::size_t>(channels, kMaxChannels)), rounds_(rounds) {}

std::size_t Mixer::SlotOf(int channel) const {
    return static_cast<std::size_t>(channel % kMaxChannels);
}

Mixer::Channel* Mixer::Find(int channel) {
    if (channel < 0 || SlotOf(channel) >= channels_.size()) return nullptr;
    Channel& found = channels_[SlotOf(channel)];
    return found.number == channel ? &found : nullptr;
}

const Mixer::Channel* Mixer::Find(int channel) const {
    return const_cast<Mixer*>(this)->Find(channel);
}

int Mixer::Start(DecodeAhead& source, float gain, bool paused) {
    const auto unused = std::find_if(channels_.begin(), channels_.end(), [](const Channel& channel) {
        return channel.number == kNoChannel || channel.over.load(std::memory_order_acquire);
    });
    if (unused == channels_.end()) return kNoChannel;
    Detach(*unused);
    unused->paused.store(paused, std::memory_order_relaxed);
    unused->over.store(false, std::memory_order_relaxed);
    unused->gain.store(gain, std::memory_order_relaxed);
    unused->left.store(1, std::memory_order_relaxed);
    unused->right.store(1, std::memory_order_relaxed);
    unused->now = {};
    unused->fresh = true;
    rounds_ = (rounds_ + 1) % kRounds;
    unused->number = rounds_ * kMaxChannels + static_cast<int>(unused - channels_.begin());
    unused->source.store(&source);
    return unused->number;
}

// Sequentially consistent on both sides: either the output's thread sees that the source is gone, or this one
// sees the block that may still use it, and waits for its end (well below a millisecond).
void Mixer::Detach(Channel& channel) {
    channel.source.store(nullptr);
    const std::uint64_t epoch = epoch_.load();
    while (epoch % 2 != 0 && epoch_.load() == epoch)
        std::this_thread::yield();
    channel.number = kNoChannel;
}

void Mixer::Release(int channel) {
    Channel* found = Find(channel);
    if (found == nullptr) return;
    DecodeAhead* source = found->source.load();
    Detach(*found);
    // What has ended may be somewhere else in its file by now.
    if (source != nullptr && !found->over.load(std::memory_order_acquire)) LeaveTail(*found, *source);
}

// Where all tails sound still, many sounds end at once, and one more jump among them is not heard. Nobody
// else takes from the source now.
void Mixer::LeaveTail(const Channel& channel, DecodeAhead& source) {
    if (channel.now == Sides{}) return;
    const auto tail = std::ranges::find_if(
        tails_, [](const Tail& one) { return !one.sounds.load(std::memory_order_acquire); });
    if (tail == tails_.end()) return;
    const std::size_t frames = source.SeekPending() ? source.TakeLeft(tailSource_.data(), kBlock)
                                                    : source.Take(tailSource_.data(), kBlock);
    tail->samples.fill(0);
    Add(tail->samples.data(), tailSource_.data(), frames, channel.now, {}, frames);
    tail->frames = frames;
    tail->done = 0;
    tail->sounds.store(frames > 0, std::memory_order_release);
}

void Mixer::ReleaseAll() {
    for (const Channel& channel : channels_)
        Release(channel.number);
}

bool Mixer::Playing(int channel) const {
    const Channel* found = Find(channel);
    return found != nullptr && !found->over.load(std::memory_order_acquire);
}

bool Mixer::SetPaused(int channel, bool paused) {
    Channel* found = Find(channel);
    if (found != nullptr) found->paused.store(paused, std::memory_order_relaxed);
    return found != nullptr;
}

bool Mixer::Paused(int channel) const {
    const Channel* found = Find(channel);
    return found != nullptr && found->paused.load(std::memory_order_relaxed);
}

bool Mixer::SetGain(int channel, float gain) {
    Channel* found = Find(channel);
    if (found != nullptr) found->gain.store(std::clamp(gain, 0.0F, 1.0F), std::memory_order_relaxed);
    return found != nullptr;
}

bool Mixer::SetSides(int channel, float left, float right) {
    Channel* found = Find(channel);
    if (found == nullptr) return false;
    found->left.store(left, std::memory_order_relaxed);
    found->right.store(right, std::memory_order_relaxed);
    return true;
}

void Mixer::WaitReady(std::size_t frames) {
    for (Channel& channel : channels_) {
        DecodeAhead* source = channel.source.load();
        // A channel that has just been paused glides out over one more block.
        const bool silent = channel.paused.load() && channel.now == Sides{};
        if (source != nullptr && !channel.over.load() && !silent) source->WaitReady(frames);
    }
}

void Mixer::Heard(float* mono, std::size_t count) const {
    const std::uint64_t end = played_.load(std::memory_order_acquire);
    for (std::size_t i = 0; i < count; ++i) {
        const std::uint64_t at = end + kHeard - count + i;
        mono[i] = heard_[at % kHeard].load(std::memory_order_relaxed);
    }
}

void Mixer::Render(float* stereo, std::size_t frames) {
    for (std::size_t done = 0; done < frames;) {
        const std::size_t count = std::min(kBlock, frames - done);
        epoch_.fetch_add(1);
        RenderBlock(stereo + 2 * done, count);
        epoch_.fetch_add(1);
        done += count;
    }
}

void Mixer::RenderBlock(float* stereo, std::size_t frames) {
    std::fill_n(stereo, 2 * frames, 0.0F);
    for (Channel& channel : channels_)
        AddChannel(channel, stereo, frames);
    for (Tail& tail : tails_)
        AddTail(tail, stereo, frames);
    ApplyMaster(stereo, frames);
    for (std::size_t i = 0; i < 2 * frames; ++i)
        stereo[i] = std::min(std::max(stereo[i], -1.0F), 1.0F);  // two instructions, std::clamp branches
    Keep(stereo, frames);
}

void Mixer::ApplyMaster(float* stereo, std::size_t frames) {
    const float target = master_.load(std::memory_order_relaxed);
    if (target == 1 && masterNow_ == 1) return;
    const float step = (target - masterNow_) / static_cast<float>(frames);
    for (std::size_t i = 0; i < frames; ++i) {
        const float gain = masterNow_ + step * static_cast<float>(i + 1);
        stereo[2 * i] *= gain;
        stereo[2 * i + 1] *= gain;
    }
    masterNow_ = target;
}

void Mixer::AddChannel(Channel& channel, float* stereo, std::size_t frames) {
    DecodeAhead* source = channel.source.load();
    if (source == nullptr || channel.over.load(std::memory_order_relaxed)) return;

    if (source->SeekPending()) {
        const std::size_t left = source->TakeLeft(scratch_.data(), frames);
        Add(stereo, scratch_.data(), left, channel.now, {}, left);
        channel.now = {};
    }
    const bool paused = channel.paused.load(std::memory_order_relaxed);
    if (paused && channel.now == Sides{}) return;

    const float gain = paused ? 0 : channel.gain.load(std::memory_order_relaxed);
    const Sides target = {gain * channel.left.load(std::memory_order_relaxed),
                          gain * channel.right.load(std::memory_order_relaxed)};
    if (channel.fresh) channel.now = target;
    const std::size_t count = source->Take(scratch_.data(), frames);
    if (count > 0) {
        Add(stereo, scratch_.data(), count, channel.now, target, frames);
        channel.now = target;
        channel.fresh = false;
    }
    if (source->Exhausted())
        channel.over.store(true, std::memory_order_release);
    else if (count < frames)
        starved_.fetch_add(frames - count, std::memory_order_relaxed);
}

void Mixer::AddTail(Tail& tail, float* stereo, std::size_t frames) {
    if (!tail.sounds.load(std::memory_order_acquire)) return;
    const std::size_t count = std::min(frames, tail.frames - tail.done);
    AddSteady(stereo, tail.samples.data() + 2 * tail.done, count, {1, 1});
    tail.done += count;
    if (tail.done == tail.frames) tail.sounds.store(false, std::memory_order_release);
}

void Mixer::AddSteady(float* target, const float* source, std::size_t frames, Sides gain) {
    for (std::size_t i = 0; i < frames; ++i) {
        target[2 * i] += source[2 * i] * gain.left;
        target[2 * i + 1] += source[2 * i + 1] * gain.right;
    }
}

// The gain goes from `from` to `to` in a straight line of `over` frames.
void Mixer::Add(float* target, const float* source, std::size_t frames, Sides from, Sides to,
                std::size_t over) {
    if (from == to) return AddSteady(target, source, frames, to);
    const float step = over > 0 ? 1.0F / static_cast<float>(over) : 0;
    for (std::size_t i = 0; i < frames; ++i) {
        const float way = step * static_cast<float>(i + 1);
        target[2 * i] += source[2 * i] * (from.left + (to.left - from.left) * way);
        target[2 * i + 1] += source[2 * i + 1] * (from.right + (to.right - from.right) * way);
    }
}

void Mixer::Keep(const float* stereo, std::size_t frames) {
    const std::uint64_t from = played_.load(std::memory_order_relaxed);
    for (std::size_t i = 0; i < frames; ++i)
        heard_[(from + i) % kHeard].store((stereo[2 * i] + stereo[2 * i + 1]) / 2, std::memory_order_relaxed);
    played_.store(from + frames, std::memory_order_release);
}
