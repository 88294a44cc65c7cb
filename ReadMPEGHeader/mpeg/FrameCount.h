#pragma once

#include <cstdint>

#include "CommonRUKTools/FileSource.h"
#include "ReadMPEGHeader/mpeg/IsoFrame.h"

// All frames of a stream, one by one.
struct FrameCount {
    std::int64_t Frames = 0;     // without the one that only carries a VBR header
    std::int64_t Bytes = 0;      // of these frames
    std::int64_t Samples = 0;    // of one channel, at the sample rate of First
    std::int64_t Skipped = 0;    // bytes between frames that belong to none: the stream is damaged there
    std::int64_t Announced = 0;  // frames that a VBR header speaks of; 0 when there is none
    IsoFrame First;

    std::int64_t Seconds() const;  // whole ones
    std::int64_t BitRate() const;  // kbit/s, the mean
};

// Follows the frames from `begin`, where one must stand, to the tags behind them or to the end of the file.
// Frames of free format, whose length no header tells, are not followed: nothing is counted then. Throws
// EMediumError.
FrameCount CountMpegFrames(ByteSource& stream, std::int64_t begin);
