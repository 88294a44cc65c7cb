#pragma once

#include <QSharedMemory>
#include <array>
#include <cstddef>
#include <cstdint>

inline constexpr std::size_t kSpectrumBands = 512;
// Amplitudes from 0 Hz to half the mix rate; 1 is full level.
using SpectrumBands = std::array<float, kSpectrumBands>;

// The shared-memory block "RUK DSP " through which a player, in this program or in another one, tells what
// sounds now. One writes, any number read; nobody ever waits for another one.
class SpectrumBlock {
 public:
    // Every user has a block of his own. Tests give a key of theirs.
    explicit SpectrumBlock(const QString& key = UserKey());

    // Takes part in the block and makes it where there is none. False when the system gives none.
    bool Open();
    bool IsOpen() const { return memory_.isAttached(); }
    void Close() { memory_.detach(); }

    void Write(const SpectrumBands& bands);
    // False when nothing has been written since the last successful call, or something is being written now.
    bool Read(SpectrumBands& bands);
    // Counts the calls of Read by anybody; wraps. Whoever writes sees by it whether somebody looks.
    std::uint32_t Looks();

 private:
    struct Contents;

    static QString UserKey();
    Contents* Shared();

    QSharedMemory memory_;
    std::uint32_t seen_ = 0;
};
