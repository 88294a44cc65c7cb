#pragma once

#include <QtGlobal>
#include <optional>

// Estimates how long a run will still take from how far it has come. Times are milliseconds of a monotonic
// clock.
class RemainingTime {
 public:
    void Start(qint64 now);
    // Seconds; nothing in the first two seconds, before there is progress, or while the end is unknown
    // (maximum not above 0).
    std::optional<int> Estimate(qint64 current, qint64 maximum, qint64 now);

 private:
    qint64 begin_ = 0;
    qint64 first_ = 0;  // progress at the begin
    qint64 last_ = 0;
    qint64 maximum_ = 0;
};
