#pragma once

#include <atomic>
#include <condition_variable>
#include <deque>
#include <functional>
#include <limits>
#include <memory>
#include <mutex>
#include <thread>

#include "MusicManagment/playback/fmod/SampleRing.h"
#include "MusicManagment/playback/fmod/SoundSource.h"

// Keeps a source decoded about half a second ahead of what is heard, in a thread of its own. Three threads
// meet here: the owner's, which seeks and asks; the decoding one; and the mixing one, which takes frames and
// never waits. A seek writes behind what is still in the ring; the mixing thread jumps there by itself.
class DecodeAhead {
 public:
    // `rate` in Hz: that of the source's frames.
    DecodeAhead(std::unique_ptr<SoundSource> source, int rate);
    ~DecodeAhead();
    DecodeAhead(const DecodeAhead&) = delete;
    DecodeAhead& operator=(const DecodeAhead&) = delete;

    // --- the owner's thread

    // Moves the source with a function that returns the frame it goes on from. What it throws passes on, and
    // everything stays as it was.
    void Reposition(const std::function<std::uint64_t(SoundSource&)>& move);
    void Seek(std::uint64_t frame);
    // Lets a function change the source while nothing is being decoded.
    void Change(const std::function<void(SoundSource&)>& change);

    std::uint64_t Position() const;  // frames
    SongPlace Place() const;
    // Everything has been decoded and taken.
    bool Exhausted() const { return ring_.Taken() >= end_.load(std::memory_order_acquire); }
    // Returns when so many frames can be taken, or as many as there ever will be.
    void WaitReady(std::size_t frames);

    // --- the mixing thread

    // True when a seek has left frames in the ring that are not to be heard.
    bool SeekPending() const { return ring_.Taken() < start_.load(std::memory_order_acquire); }
    // Takes up to `frames` of them, for fading them out, and jumps to where the seek goes on.
    std::size_t TakeLeft(float* stereo, std::size_t frames);
    // Takes up to `frames`; fewer when the decoder is late or at the end.
    std::size_t Take(float* stereo, std::size_t frames);

 private:
    struct Mark {
        std::uint64_t from;  // place in the ring
        SongPlace place;
    };
    static constexpr std::uint64_t kNoEnd = std::numeric_limits<std::uint64_t>::max();

    void Run();
    void DecodeSome();
    std::uint64_t Ahead() const;  // frames decoded and not taken
    bool HasRoom() const;
    bool Ready(std::size_t frames) const;
    void DropHeardMarks() const;
    void AddMark(std::uint64_t from, SongPlace place);

    const std::unique_ptr<SoundSource> source_;
    const std::size_t target_;  // frames to keep ahead
    SampleRing ring_;           // twice as large, so that a seek finds room beside what it leaves
    std::vector<float> chunk_;
    // Where in the ring the frames since the last seek start and end.
    std::atomic<std::uint64_t> start_{0};
    std::atomic<std::uint64_t> end_{kNoEnd};
    std::uint64_t startFrame_ = 0;  // of the source; the owner's thread only

    mutable std::mutex mutex_;  // source, marks and the flags below
    std::condition_variable work_;
    std::condition_variable ready_;
    mutable std::deque<Mark> marks_;
    std::size_t awaited_ = 0;  // frames that WaitReady waits for
    bool quit_ = false;
    std::thread thread_;
};
