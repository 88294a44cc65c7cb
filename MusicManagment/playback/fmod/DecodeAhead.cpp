#include "MusicManagment/playback/fmod/DecodeAhead.h"

#include <algorithm>
#include <chrono>

namespace {

constexpr std::size_t kChunk = 1024;  // frames decoded at a time
// The mixing thread never wakes the decoder, since that could make it wait; the decoder looks by itself, far
// more often than the ring lasts.
constexpr auto kLookInterval = std::chrono::milliseconds(100);

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
    return Ahead() >= frames || ring_.Written() >= end_.load(std::memory_order_acquire) || !HasRoom();
}

void DecodeAhead::WaitReady(std::size_t frames) {
    if (Ready(frames)) return;
    std::unique_lock lock(mutex_);
    awaited_ = std::max(frames, target_ / 4);
    work_.notify_all();
    ready_.wait(lock, [&] { return Ready(awaited_); });
    awaited_ = 0;
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

// What is written last is read last: it only grows, whatever the other threads do meanwhile.
std::uint64_t DecodeAhead::Ahead() const {
    const std::uint64_t from = std::max(ring_.Taken(), start_.load(std::memory_order_acquire));
    return ring_.Written() - from;
}

bool DecodeAhead::HasRoom() const {
    const std::uint64_t taken = ring_.Taken();
    return Ahead() + kChunk <= target_ && ring_.Written() - taken + kChunk <= ring_.Capacity();
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

// In bursts: a decoder that goes on for a while finds its tables in the cache, one that is woken for every
// block does not and takes twice the time.
void DecodeAhead::Run() {
    std::unique_lock lock(mutex_);
    bool filling = true;
    while (!quit_) {
        const bool ended = end_.load(std::memory_order_relaxed) != kNoEnd;
        filling = !ended && HasRoom() && (filling || awaited_ > 0 || Ahead() <= target_ / 2);
        if (!filling) {
            work_.wait_for(lock, kLookInterval);
            continue;
        }
        DecodeSome();
        const bool answer = awaited_ > 0 && Ready(awaited_);
        // A moment for whoever wants to seek or ask.
        lock.unlock();
        if (answer) ready_.notify_all();
        lock.lock();
    }
}
