#include "app/dialogs/RemainingTime.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr qint64 kSettlingTime = 2000;
constexpr double kLongest = 359'999;  // seconds: 99:59:59

}  // namespace

void RemainingTime::Start(qint64 now) {
    begin_ = now;
    first_ = last_ = 0;
    maximum_ = 0;
}

std::optional<int> RemainingTime::Estimate(qint64 current, qint64 maximum, qint64 now) {
    // A run may have several stages; what one took says nothing about the next.
    if (maximum != maximum_ || current < last_) {
        begin_ = now;
        first_ = current;
        maximum_ = maximum;
    }
    last_ = current;
    const qint64 done = current - first_;
    if (maximum <= 0 || done <= 0 || now - begin_ < kSettlingTime) return std::nullopt;
    const double left = static_cast<double>(std::max<qint64>(0, maximum - current));
    const double seconds = static_cast<double>(now - begin_) / 1000.0 * left / static_cast<double>(done);
    return static_cast<int>(std::lround(std::min(seconds, kLongest)));
}
