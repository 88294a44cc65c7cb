#pragma once

#include <QtGlobal>
#include <limits>
#include <utility>

// Values of a container as the fields of a TID3Tag hold them.

// `value`, or the nearest bound of `Target`.
template <typename Target, typename Value>
constexpr Target Saturated(Value value) {
    using Limits = std::numeric_limits<Target>;
    if (std::cmp_less(value, Limits::min())) return Limits::min();
    if (std::cmp_greater(value, Limits::max())) return Limits::max();
    return static_cast<Target>(value);
}

// Channel mode of containers that count channels (WAV, WMA); 0 for a count without a mode.
constexpr quint8 ChannelModeByCount(int channels) {
    switch (channels) {
        case 1:
            return 1;
        case 2:
            return 2;
        case 4:
            return 5;
        case 6:
            return 6;
        case 8:
            return 7;
        default:
            return 0;
    }
}
