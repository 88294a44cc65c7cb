#pragma once

#include <array>
#include <cstdint>

#include "ReadMPEGHeader/asf/Asf.h"
#include "ReadMPEGHeader/asf/AsfAttributes.h"
#include "ReadMPEGHeader/asf/AsfCursor.h"

using AsfGuid = std::array<std::uint8_t, 16>;  // as it stands in the file

inline constexpr AsfGuid kAsfHeaderObject = {0x30, 0x26, 0xB2, 0x75, 0x8E, 0x66, 0xCF, 0x11,
                                             0xA6, 0xD9, 0x00, 0xAA, 0x00, 0x62, 0xCE, 0x6C};

// What has been gathered while the objects of a header are read.
struct AsfHeader {
    TASFInfo Info;
    AsfAttributes Attributes;
    std::uint32_t MaximumBitRate = 0;  // of all streams together, bit/s
    bool HasAudio = false;
    bool HasCodec = false;
    bool KnowsAnything = false;  // at least one object was understood
};

// Reads the objects that fill `objects`, each into `header`; a damaged one leaves no trace.
void ReadAsfObjects(AsfCursor objects, AsfHeader& header);
