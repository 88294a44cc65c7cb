#include "CommonRUKTools/Clock.h"

#include <chrono>
#include <cmath>

namespace {

constexpr double kMsPerDay = 86'400'000.0;

QDate Epoch() {
    return {1899, 12, 30};
}

class SystemClock : public Clock {
 public:
    qint64 Ticks() const override {
        using namespace std::chrono;
        return duration_cast<milliseconds>(steady_clock::now().time_since_epoch()).count();
    }
    double Now() const override { return ToDayCount(QDateTime::currentDateTime()); }
};

const Clock*& Installed() {
    static const Clock* clock = nullptr;
    return clock;
}

}  // namespace

const Clock& CurrentClock() {
    static const SystemClock system;
    return Installed() != nullptr ? *Installed() : system;
}

void SetClock(const Clock* clock) {
    Installed() = clock;
}

double ToDayCount(const QDateTime& time) {
    if (!time.isValid()) return 0;
    const auto days = static_cast<double>(Epoch().daysTo(time.date()));
    return days + static_cast<double>(time.time().msecsSinceStartOfDay()) / kMsPerDay;
}

QDateTime FromDayCount(double days) {
    // Outside these bounds (years 1 to 9999) a date is damage, not information.
    if (!std::isfinite(days) || days < -693'593.0 || days > 2'958'465.0) return {};
    const double whole = std::floor(days);
    const auto ms = static_cast<int>(std::lround((days - whole) * kMsPerDay));
    return QDateTime(Epoch().addDays(static_cast<qint64>(whole)), QTime(0, 0)).addMSecs(ms);
}
