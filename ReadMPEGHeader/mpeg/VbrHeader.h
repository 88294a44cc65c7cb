#pragma once

#include <QtGlobal>
#include <optional>

#include "CommonRUKTools/ByteReader.h"

struct MpegHeader;

// What encoders tell about the whole stream inside its first frame, which carries no sound then.
struct VbrHeader {
    enum class Kind {
        Xing,  // variable bit rate
        Vbri,  // variable bit rate, Fraunhofer's encoder
        Info,  // LAME's "Xing" of a stream with a constant bit rate
    };
    Kind Type = Kind::Xing;
    quint32 FrameCount = 0;              // 0 when the header does not tell
    std::optional<quint32> StreamBytes;  // nothing: as many as the file holds
    quint8 Marker = 0;                   // the byte that is kept in MpegResults
};

// At least so many bytes of a frame are needed to look for a VBR header.
inline constexpr std::size_t kVbrHeaderSpan = 64;

// A way to look for a VBR header in the first bytes of a frame, whose header is `header`.
using VbrFinder = std::optional<VbrHeader> (*)(ByteSpan frame, const MpegHeader& header);

// "Xing" and "VBRI" with this program's own offsets; the flags of "Xing" are not consulted.
std::optional<VbrHeader> FindVbrHeaderClassic(ByteSpan frame, const MpegHeader& header);

// "Xing", "Info" and "VBRI" as encoders write them: behind the side information of each version, with only
// the fields that the flags announce; a size of 0 tells nothing.
std::optional<VbrHeader> FindVbrHeaderModern(ByteSpan frame, const MpegHeader& header);
// The same for a frame whose header is yet to be read.
std::optional<VbrHeader> VbrHeaderIn(ByteSpan frame);
