#pragma once

#include <QtGlobal>
#include <algorithm>
#include <cstdint>
#include <limits>

// Values of a container as the fields of a TID3Tag hold them.

// `value`, or the nearest bound of `Target`.
template <typename Target>
constexpr Target Saturated(std::int64_t value) {
    return static_cast<Target>(std::clamp<std::int64_t>(value, std::numeric_limits<Target>::min(),
                                                        std::numeric_limits<Target>::max()));
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
