#pragma once

#include <QtGlobal>
#include <optional>

// Decides when a song counts as played: once, after it has played for 30 seconds without a pause.
class PlayCountClock {
 public:
    static constexpr qint64 kPlayedAfter = 30000;  // ms

    // Another song: it may be counted.
    void Arm() {
        counted_ = false;
        start_.reset();
    }
    // The song begins to play, or goes on, at these ticks.
    void Start(qint64 now) {
        if (!counted_) start_ = now;
    }
    // True at the first call that comes late enough.
    bool Due(qint64 now) {
        if (counted_ || !start_ || now - *start_ < kPlayedAfter) return false;
        counted_ = true;
        return true;
    }

 private:
    bool counted_ = true;
    std::optional<qint64> start_;
};
