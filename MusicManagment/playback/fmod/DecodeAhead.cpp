#include "MusicManagment/playback/fmod/DecodeAhead.h"

#include <algorithm>
#include <chrono>

namespace {

constexpr std::size_t kChunk = 1024;  // frames decoded at a time
// The mixing thread never wakes the decoder, since that could make it wait; the decoder looks by itself, far
// more often than the ring lasts.
constexpr auto kLookInterval = std::chrono::milliseconds(50);

std::size_t HalfASecond(int rate) {
    return std::max(4 * kChunk, std::bit_ceil(static_cast<std::size_t>(rate) / 2));
}

}  // namespace

DecodeAhead::DecodeAhead(std::unique_ptr<SoundSource> source, int rate)
    : source_(std::move(source)), target_(HalfASecond(rate)), ring_(2 * target_), chunk_(2 * kChunk) {
    thread_ = std::thread([this] { Run(); });
}

DecodeAhead::~DecodeAhead() {
    {
        const std::lock_guard lock(mutex_);
        quit_ = true;
    }
    work_.notify_all();
    thread_.join();
}

void DecodeAhead::Reposition(const std::function<std::uint64_t(SoundSource&)>& move) {
    const std::lock_guard lock(mutex_);
    startFrame_ = move(*source_);
    marks_.clear();
    AddMark(ring_.Written(), source_->Place());
    end_.store(kNoEnd, std::memory_order_release);
    start_.store(ring_.Written(), std::memory_order_release);
    work_.notify_all();
}

void DecodeAhead::Seek(std::uint64_t frame) {
    Reposition([frame](SoundSource& source) { return source.Seek(frame); });
}

void DecodeAhead::Change(const std::function<void(SoundSource&)>& change) {
    const std::lock_guard lock(mutex_);
    change(*source_);
}

std::uint64_t DecodeAhead::Position() const {
    const std::uint64_t start = start_.load(std::memory_order_acquire);
    return startFrame_ + (std::max(ring_.Taken(), start) - start);
}

SongPlace DecodeAhead::Place() const {
    const std::lock_guard lock(mutex_);
    DropHeardMarks();
    return marks_.empty() ? SongPlace{} : marks_.front().place;
}

// The first mark left is that of the frame being heard.
void DecodeAhead::DropHeardMarks() const {
    const std::uint64_t heard = ring_.Taken();
    while (marks_.size() > 1 && marks_[1].from <= heard)
        marks_.pop_front();
}

bool DecodeAhead::Ready(std::size_t frames) const {
    const std::uint64_t written = ring_.Written();
    const std::uint64_t from = std::max(ring_.Taken(), start_.load(std::memory_order_acquire));
    return written - from >= frames || written >= end_.load(std::memory_order_acquire) || !HasRoom();
}

void DecodeAhead::WaitReady(std::size_t frames) {
    std::unique_lock lock(mutex_);
    work_.notify_all();
    ready_.wait(lock, [&] { return Ready(frames); });
}

std::size_t DecodeAhead::TakeLeft(float* stereo, std::size_t frames) {
    const std::uint64_t start = start_.load(std::memory_order_acquire);
    const std::uint64_t taken = ring_.Taken();
    if (taken >= start) return 0;
    const std::size_t count = static_cast<std::size_t>(std::min<std::uint64_t>(frames, start - taken));
    ring_.Take(stereo, count);
    ring_.SkipTo(start);
    return count;
}

std::size_t DecodeAhead::Take(float* stereo, std::size_t frames) {
    const std::size_t count =
        static_cast<std::size_t>(std::min<std::uint64_t>(frames, ring_.Written() - ring_.Taken()));
    ring_.Take(stereo, count);
    return count;
}

bool DecodeAhead::HasRoom() const {
    const std::uint64_t written = ring_.Written();
    const std::uint64_t taken = ring_.Taken();
    const std::uint64_t from = std::max(taken, start_.load(std::memory_order_acquire));
    return written - from + kChunk <= target_ && written - taken + kChunk <= ring_.Capacity();
}

void DecodeAhead::AddMark(std::uint64_t from, SongPlace place) {
    DropHeardMarks();
    if (marks_.empty() || marks_.back().place != place) marks_.push_back({from, place});
}

// A source that cannot go on, for want of memory too, is at its end: its song then ends like any other.
void DecodeAhead::DecodeSome() {
    std::size_t count = 0;
    try {
        AddMark(ring_.Written(), source_->Place());
        count = source_->Read(chunk_.data(), kChunk);
    } catch (const std::exception& error) {
        qWarning("A sound file cannot be decoded any further: %s", error.what());
    }
    ring_.Write(chunk_.data(), count);
    if (count < kChunk) {
        AddMark(ring_.Written(), source_->Place());
        end_.store(ring_.Written(), std::memory_order_release);
    }
}

void DecodeAhead::Run() {
    std::unique_lock lock(mutex_);
    while (!quit_) {
        if (end_.load(std::memory_order_relaxed) != kNoEnd || !HasRoom()) {
            work_.wait_for(lock, kLookInterval);
            continue;
        }
        DecodeSome();
        ready_.notify_all();
        // A moment for whoever wants to seek or ask.
        lock.unlock();
        lock.lock();
    }
}
