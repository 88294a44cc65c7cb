#pragma once

#include <algorithm>
#include <atomic>
#include <bit>
#include <cstddef>
#include <cstdint>
#include <vector>

// Stereo frames on their way from one writing to one reading thread, without a lock. Places in it are counted
// from its beginning and never start again.
class SampleRing {
 public:
    explicit SampleRing(std::size_t frames) : samples_(2 * std::bit_ceil(frames)) {}

    std::size_t Capacity() const { return samples_.size() / 2; }
    std::uint64_t Written() const { return written_.load(std::memory_order_acquire); }
    std::uint64_t Taken() const { return taken_.load(std::memory_order_acquire); }

    // Writing thread. At most Capacity() - (Written() - Taken()) frames.
    void Write(const float* stereo, std::size_t frames) {
        const std::uint64_t at = written_.load(std::memory_order_relaxed);
        const std::size_t first = std::min(frames, UntilWrap(at));
        std::copy_n(stereo, 2 * first, Slot(at));
        std::copy_n(stereo + 2 * first, 2 * (frames - first), samples_.data());
        written_.store(at + frames, std::memory_order_release);
    }

    // Reading thread. At most Written() - Taken() frames.
    void Take(float* stereo, std::size_t frames) {
        const std::uint64_t at = taken_.load(std::memory_order_relaxed);
        const std::size_t first = std::min(frames, UntilWrap(at));
        std::copy_n(Slot(at), 2 * first, stereo);
        std::copy_n(samples_.data(), 2 * (frames - first), stereo + 2 * first);
        taken_.store(at + frames, std::memory_order_release);
    }
    // Reading thread. Leaves out everything before `place`, which has been written.
    void SkipTo(std::uint64_t place) { taken_.store(place, std::memory_order_release); }

 private:
    std::size_t UntilWrap(std::uint64_t at) const {
        return Capacity() - static_cast<std::size_t>(at % Capacity());
    }
    float* Slot(std::uint64_t at) { return samples_.data() + 2 * static_cast<std::size_t>(at % Capacity()); }

    std::vector<float> samples_;
    std::atomic<std::uint64_t> written_{0};
    std::atomic<std::uint64_t> taken_{0};
};
