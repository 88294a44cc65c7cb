#pragma once

#include <QDateTime>
#include <QtGlobal>

// The engine's only source of time, so that a test can set it.
class Clock {
 public:
    virtual ~Clock() = default;
    // Milliseconds of a monotonic clock with an arbitrary start.
    virtual qint64 Ticks() const = 0;
    // Local date and time as days since 30 December 1899, time of day as fraction.
    virtual double Now() const = 0;
};

// The clock in use; the system's unless another was set. The caller keeps ownership; nullptr restores the
// system's.
const Clock& CurrentClock();
void SetClock(const Clock* clock);

// Conversions of the day count (local time). An invalid QDateTime gives 0.
double ToDayCount(const QDateTime& time);
QDateTime FromDayCount(double days);
