#pragma once

#include <cstddef>
#include <optional>

#include "CommonRUKTools/ByteReader.h"

// A frame header as the standards have it (ISO 11172-3 and 13818-3, tables of bit rates included), for
// finding the way from frame to frame.
struct IsoFrame {
    unsigned Version = 0;  // as coded: 0 MPEG 2.5, 2 MPEG 2, 3 MPEG 1
    unsigned Layer = 0;    // 1 to 3
    unsigned SampleRateIndex = 0;
    int BitRate = 0;       // kbit/s; 0 in free format, where the header does not tell it
    int Coefficient = 0;   // samples of a frame divided by 8
    std::size_t Size = 0;  // bytes with header; 0 in free format

    // Nothing when the bytes begin with no sync or with a code that the standards reserve.
    static std::optional<IsoFrame> Parse(ByteSpan bytes);

    int SampleRate() const;  // Hz

    // True when both can belong to one stream.
    bool Matches(const IsoFrame& other) const {
        return Version == other.Version && Layer == other.Layer && SampleRateIndex == other.SampleRateIndex;
    }
};

// No frame is longer: MPEG 2.5 Layer II, 160 kbit/s at 8000 Hz, padded.
inline constexpr std::size_t kLargestIsoFrame = 2881;
