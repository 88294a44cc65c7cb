#pragma once

#include <QString>
#include <cstddef>
#include <functional>
#include <memory>

// Where the mix goes: a sound card, a file, nowhere. Opened once, started and stopped any number of times.
class AudioOutput {
 public:
    // Writes so many frames of two 32-bit floats (left, right; -1 to 1). Called from a thread of the output.
    using Pull = std::function<void(float* stereo, std::size_t frames)>;

    virtual ~AudioOutput() = default;

    // Rate in Hz; `frames` are asked for at a time, 0 < frames. False when there is no such output.
    virtual bool Open(int rate, std::size_t frames, Pull pull) = 0;
    virtual void Start() = 0;
    // No pull runs any more when it returns.
    virtual void Stop() = 0;
    virtual void Close() = 0;
    // True once an open output has been lost (a server ended, a disk is full). It must be closed then.
    virtual bool Failed() const = 0;
    // True when another one may be opened in the place of a lost one without doing harm.
    virtual bool Replaceable() const { return false; }

    // True when nobody but Advance pulls. Such an output may have to wait for its sources: none of it is
    // heard, all of it counts.
    virtual bool Unpaced() const { return false; }
    // Pulls so many frames at once, in the caller's thread. Nothing in outputs that have a pace of their own.
    virtual void Advance([[maybe_unused]] std::size_t frames) {}
};
