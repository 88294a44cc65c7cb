#pragma once

#include <QString>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <span>

// An output that is given its samples in advance and plays them at its own pace, 16-bit, the channels of a
// frame one after the other. It begins paused. What is cut off, paused or goes on glides (Glide.h): the
// listener hears no click. So does what still sounds when the output is destroyed.
class PushOutput {
 public:
    virtual ~PushOutput() = default;

    // Rate in Hz. False when there is no output for that.
    virtual bool Open(int rate, int channels) = 0;
    // False when there is no room for them.
    virtual bool Queue(std::span<const std::int16_t> samples) = 0;
    // Bytes that have been queued and not been played.
    virtual std::size_t Queued() = 0;
    // Forgets what is queued.
    virtual void Clear() = 0;
    virtual void SetPaused(bool paused) = 0;
    // 0 to 1 of the amplitude; heard at once, also in what is queued.
    virtual void SetGain(float gain) = 0;
    // True from when an open output has been lost until it could be opened again.
    virtual bool Failed() const = 0;
};

using PushOutputMaker = std::function<std::unique_ptr<PushOutput>()>;

// What TUNESTEAD_AUDIO in the environment asks for: "null" and files are silence that keeps time, "sdl:NAME"
// is one of SDL's drivers; the usual drivers when it is not set. Null for a text that cannot be read, so that
// a mistake is not taken for silence.
std::unique_ptr<PushOutput> PushOutputOfEnvironment();
