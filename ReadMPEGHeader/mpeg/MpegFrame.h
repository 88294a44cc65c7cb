#pragma once

#include <QString>
#include <QtGlobal>
#include <array>
#include <cstdint>

#include "CommonRUKTools/FileSource.h"
#include "ReadMPEGHeader/ID3Tag.h"
#include "ReadMPEGHeader/mpeg/MpegResults.h"
#include "ReadMPEGHeader/mpeg/VbrHeader.h"

// Audio frames of MPEG 1, 2 and 2.5 (ISO 11172-3, ISO 13818-3).

enum class MpegVersion { Reserved = 0, Mpeg1 = 10, Mpeg2 = 20, Mpeg25 = 25 };

// The four bytes that every frame begins with.
struct MpegHeader {
    MpegVersion Version = MpegVersion::Reserved;
    int Layer = 0;       // 1 to 3, 0 reserved
    int BitRate = 0;     // kbit/s, 0 for reserved codes
    int SampleRate = 0;  // Hz, 0 for reserved codes
    bool Protected = false;
    bool Padding = false;
    bool Private = false;
    bool Copyrighted = false;
    bool Original = false;
    quint8 ChannelMode = 0;  // as in TID3Tag
    quint8 Emphasis = 0;     // as in TID3Tag

    // Samples of one frame divided by 8: bytes of a frame = coefficient * bit rate / sample rate.
    int Coefficient = 0;

    bool IsMono() const { return ChannelMode == 1; }
    // Bytes that the padding bit adds.
    int PaddingBytes() const;
    // Bytes of a frame at this header's bit rate, 0 when the sample rate is unknown.
    int FrameSize() const;
    // "MPEG 1.0 Layer III"
    const QString& FormatText() const;

    // The tables of bit rates, sample rates and coefficients are this program's own and differ from the
    // standards on purpose: collections hold values that were read with them.
    static MpegHeader DecodeClassic(std::array<std::uint8_t, 4> bytes);
    // The same with the standard's bit rates and frame lengths for MPEG 2 and 2.5. A header that the standard
    // does not know is read as above.
    static MpegHeader DecodeModern(std::array<std::uint8_t, 4> bytes);
};

// How a frame is understood.
struct MpegRules {
    MpegHeader (*DecodeHeader)(std::array<std::uint8_t, 4> bytes);
    VbrFinder FindVbrHeader;
};

inline constexpr MpegRules kClassicMpegRules{MpegHeader::DecodeClassic, FindVbrHeaderClassic};
inline constexpr MpegRules kModernMpegRules{MpegHeader::DecodeModern, FindVbrHeaderModern};

constexpr bool IsFrameSync(std::uint8_t first, std::uint8_t second) {
    return first == 0xFF && (second & 0xE0) == 0xE0;
}

// Analyses the frame at `position`: fills the technical fields of `tag` and returns what is kept beside the
// record. Values that do not fit a field of the record are saturated. Damaged contents give zeros; throws
// only when the medium fails.
MpegResults AnalyseMpegFrame(ByteSource& stream, std::int64_t position, const MpegRules& rules, TID3Tag& tag);
