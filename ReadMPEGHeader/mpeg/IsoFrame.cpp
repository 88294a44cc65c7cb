#include "ReadMPEGHeader/mpeg/IsoFrame.h"

#include <array>

namespace {

using BitRateRow = std::array<int, 15>;

// kbit/s by index, 0 free format.
constexpr std::array<BitRateRow, 3> kMpeg1 = {{
    {0, 32, 64, 96, 128, 160, 192, 224, 256, 288, 320, 352, 384, 416, 448},  // Layer I
    {0, 32, 48, 56, 64, 80, 96, 112, 128, 160, 192, 224, 256, 320, 384},
    {0, 32, 40, 48, 56, 64, 80, 96, 112, 128, 160, 192, 224, 256, 320},
}};
// MPEG 2 and 2.5.
constexpr std::array<BitRateRow, 3> kLowSampleRates = {{
    {0, 32, 48, 56, 64, 80, 96, 112, 128, 144, 160, 176, 192, 224, 256},
    {0, 8, 16, 24, 32, 40, 48, 56, 64, 80, 96, 112, 128, 144, 160},
    {0, 8, 16, 24, 32, 40, 48, 56, 64, 80, 96, 112, 128, 144, 160},
}};
constexpr std::array<int, 3> kSampleRates = {44100, 48000, 32000};

constexpr unsigned kMpeg1Code = 3;

// Only Layer III has shorter frames at low sample rates.
int CoefficientOf(const IsoFrame& frame) {
    if (frame.Layer == 1) return 48;
    return frame.Layer == 3 && frame.Version != kMpeg1Code ? 72 : 144;
}

std::size_t FrameSize(const IsoFrame& frame, std::size_t padding) {
    if (frame.BitRate == 0) return 0;
    // Layer I counts in slots of four bytes.
    const std::size_t slot = frame.Layer == 1 ? 4 : 1;
    const auto bits = static_cast<std::size_t>(frame.BitRate) * 1000;
    const auto slots = static_cast<std::size_t>(frame.Coefficient) / slot * bits /
                       static_cast<std::size_t>(frame.SampleRate());
    return (slots + padding) * slot;
}

}  // namespace

// MPEG 2 halves the rates of MPEG 1, MPEG 2.5 quarters them.
int IsoFrame::SampleRate() const {
    const int divisor = Version == kMpeg1Code ? 1 : Version == 2 ? 2 : 4;
    return kSampleRates[SampleRateIndex] / divisor;
}

std::optional<IsoFrame> IsoFrame::Parse(ByteSpan bytes) {
    if (bytes.size() < 4 || bytes[0] != 0xFF || (bytes[1] & 0xE0) != 0xE0) return std::nullopt;
    const unsigned version = (bytes[1] >> 3) & 3u;
    const unsigned layerCode = (bytes[1] >> 1) & 3u;
    const unsigned bitRateIndex = bytes[2] >> 4;
    const unsigned sampleRateIndex = (bytes[2] >> 2) & 3u;
    if (version == 1 || layerCode == 0 || bitRateIndex == 15 || sampleRateIndex == 3) return std::nullopt;
    const auto& rows = version == kMpeg1Code ? kMpeg1 : kLowSampleRates;
    IsoFrame frame{.Version = version, .Layer = 4 - layerCode, .SampleRateIndex = sampleRateIndex};
    frame.BitRate = rows[frame.Layer - 1][bitRateIndex];
    frame.Coefficient = CoefficientOf(frame);
    frame.Size = FrameSize(frame, (bytes[2] >> 1) & 1u);
    return frame;
}
