#pragma once

#include <array>
#include <atomic>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <vector>

#include "MusicManagment/playback/fmod/DecodeAhead.h"

// Adds up the sounds of its channels. One thread, the owner's, starts and changes channels; another one, the
// output's, renders. Rendering takes no lock and allocates nothing: it sees a change through atomics at its
// next block, and glides there over that block.
class Mixer {
 public:
    static constexpr std::size_t kBlock = 1024;  // frames; the longest glide
    static constexpr std::size_t kHeard = 4096;  // frames kept for the spectrum
    static constexpr int kNoChannel = -1;

    // `rounds` are those of the mixer before this one, so that its channel numbers are not used again.
    explicit Mixer(std::size_t channels, int rounds = 0);

    // --- the owner's thread

    // Returns a channel that is never the number of an earlier one; kNoChannel when all are taken. The source
    // must stay until Release, the sound begins with its next frame.
    int Start(DecodeAhead& source, float gain, bool paused);
    // The source is not touched any more when it returns. A block of what it has ready is taken, so that the
    // sound glides into silence.
    void Release(int channel);
    void ReleaseAll();  // each of them
    // How often channels have been started, here and in the mixers before; wraps.
    int Rounds() const { return rounds_; }
    // False for a channel that is over.
    bool Playing(int channel) const;
    // These do nothing and answer false for a number that is no channel now.
    bool SetPaused(int channel, bool paused);
    bool Paused(int channel) const;
    bool SetGain(int channel, float gain);  // 0 to 1
    // Gain of the two sides, 0 to 1 each.
    bool SetSides(int channel, float left, float right);

    // Gain of the whole mix, 0 to 1.
    void SetMaster(float gain) { master_.store(gain, std::memory_order_relaxed); }

    std::uint64_t FramesPlayed() const { return played_.load(std::memory_order_relaxed); }
    // Frames that a channel could not fill because its source was late.
    std::uint64_t FramesStarved() const { return starved_.load(std::memory_order_relaxed); }
    // The last `count` frames as mono, count <= kHeard. May be torn by a running block.
    void Heard(float* mono, std::size_t count) const;

    // --- the output's thread

    // Waits until the channels can give so many frames: for outputs that are not heard.
    void WaitReady(std::size_t frames);
    void Render(float* stereo, std::size_t frames);

 private:
    struct Sides {
        float left = 0;
        float right = 0;
        bool operator==(const Sides&) const = default;
    };
    struct Channel {
        std::atomic<DecodeAhead*> source{nullptr};
        std::atomic<bool> paused{false};
        std::atomic<bool> over{false};  // the source has come to its end
        std::atomic<float> gain{0};
        std::atomic<float> left{1};
        std::atomic<float> right{1};
        int number = kNoChannel;  // the owner's thread only
        // The output's thread only, while a source is set.
        Sides now;
        bool fresh = true;  // nothing sounded yet, so there is nothing to glide from
    };

    // What is left of a released sound, already gliding into silence. The owner's thread fills one that is
    // free, the output's empties it.
    struct Tail {
        std::atomic<bool> sounds{false};
        std::size_t frames = 0;
        std::size_t done = 0;  // of these
        std::array<float, 2 * kBlock> samples{};
    };
    static constexpr std::size_t kTails = 4;

    std::size_t SlotOf(int channel) const;
    Channel* Find(int channel);
    const Channel* Find(int channel) const;
    void Detach(Channel& channel);
    void LeaveTail(const Channel& channel, DecodeAhead& source);
    void AddTail(Tail& tail, float* stereo, std::size_t frames);
    void RenderBlock(float* stereo, std::size_t frames);
    void AddChannel(Channel& channel, float* stereo, std::size_t frames);
    static void AddSteady(float* target, const float* source, std::size_t frames, Sides gain);
    static void Add(float* target, const float* source, std::size_t frames, Sides from, Sides to,
                    std::size_t over);
    void ApplyMaster(float* stereo, std::size_t frames);
    void Keep(const float* stereo, std::size_t frames);

    std::vector<Channel> channels_;
    std::array<Tail, kTails> tails_;
    int rounds_;
    std::atomic<float> master_{1};
    float masterNow_ = 1;  // the output's thread only
    std::array<float, 2 * kBlock> scratch_{};
    std::array<float, 2 * kBlock> tailSource_{};  // the owner's thread only
    // Odd while a block is being rendered.
    std::atomic<std::uint64_t> epoch_{0};
    std::atomic<std::uint64_t> played_{0};
    std::atomic<std::uint64_t> starved_{0};
    std::array<std::atomic<float>, kHeard> heard_{};
};
