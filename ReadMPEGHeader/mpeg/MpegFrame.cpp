#include "ReadMPEGHeader/mpeg/MpegFrame.h"

#include <algorithm>

#include "ReadMPEGHeader/FieldValues.h"
#include "ReadMPEGHeader/mpeg/IsoFrame.h"

using namespace Qt::StringLiterals;

namespace {

// An ID3v1 tag and 20 further bytes are not counted as sound.
constexpr std::int64_t kBytesBehindAudio = 148;
// Shorter files are not asked for a VBR header.
constexpr std::int64_t kLeastBytesForVbr = 256;

using BitRateRow = std::array<qint16, 16>;

// kbit/s by version, layer and index. Index 0 (free format) and 15 (forbidden) carry values on purpose, and
// the rows of MPEG 2 and 2.5 are not the standard's.
constexpr std::array<std::array<BitRateRow, 3>, 3> kBitRates = {{
    {{
        {1, 32, 64, 96, 128, 160, 192, 224, 256, 288, 320, 352, 384, 416, 448, 480},  // MPEG 1 Layer I
        {24, 32, 48, 56, 64, 80, 96, 112, 128, 160, 192, 224, 256, 320, 384, 448},
        {24, 32, 40, 48, 56, 64, 80, 96, 112, 128, 160, 192, 224, 256, 320, 384},
    }},
    {{
        {24, 32, 64, 96, 128, 160, 192, 224, 256, 288, 320, 352, 384, 416, 448, 480},  // MPEG 2 Layer I
        {16, 32, 48, 56, 64, 80, 96, 112, 128, 160, 192, 224, 256, 320, 384, 448},
        {4, 8, 16, 24, 32, 64, 80, 56, 64, 128, 160, 112, 128, 256, 320, 384},
    }},
    {{
        {24, 32, 64, 96, 128, 160, 192, 224, 256, 288, 320, 352, 384, 416, 448, 480},  // MPEG 2.5 Layer I
        {24, 32, 48, 56, 64, 80, 96, 112, 128, 160, 192, 224, 256, 320, 384, 448},
        {24, 32, 40, 48, 56, 64, 80, 96, 112, 128, 160, 192, 224, 256, 320, 384},
    }},
}};

// Hz by version and index. MPEG 2.5 has no index 3.
constexpr std::array<std::array<int, 4>, 3> kSampleRates = {{
    {44100, 48000, 32000, 24000},
    {22050, 24000, 16000, 12000},
    {11025, 12000, 8000, 0},
}};

constexpr std::array<MpegVersion, 4> kVersions = {MpegVersion::Mpeg25, MpegVersion::Reserved,
                                                  MpegVersion::Mpeg2, MpegVersion::Mpeg1};
constexpr std::array<quint8, 4> kChannelModes = {2, 3, 4, 1};
constexpr std::array<quint8, 4> kEmphases = {1, 3, 2, 4};

// Row of the tables, for versions that have one.
std::size_t VersionRow(MpegVersion version) {
    return version == MpegVersion::Mpeg1 ? 0 : version == MpegVersion::Mpeg2 ? 1 : 2;
}

int TableBitRate(MpegVersion version, int layer, unsigned index) {
    if (version == MpegVersion::Reserved || layer == 0) return 0;
    return kBitRates[VersionRow(version)][static_cast<std::size_t>(layer) - 1][index];
}

int TableSampleRate(MpegVersion version, unsigned index) {
    return version == MpegVersion::Reserved ? 0 : kSampleRates[VersionRow(version)][index];
}

int TableCoefficient(MpegVersion version, int layer) {
    if (version == MpegVersion::Mpeg1) return layer == 1 ? 48 : 144;
    return layer == 1 ? 24 : 72;
}

struct Estimate {
    std::int64_t FrameSize = 0;  // bytes
    std::int64_t FrameCount = 0;
    std::int64_t Length = 0;   // seconds
    std::int64_t BitRate = 0;  // kbit/s
};

// As if every frame were as long as the first one.
Estimate ConstantBitRate(const MpegHeader& header, std::int64_t audioBytes) {
    Estimate result;
    result.FrameSize = header.FrameSize();
    result.BitRate = header.BitRate;
    if (result.FrameSize > 0) result.FrameCount = audioBytes / result.FrameSize;
    if (result.BitRate > 0) result.Length = audioBytes / (result.BitRate * 125);
    return result;
}

std::int64_t LengthOfFrames(const MpegHeader& header, std::int64_t frames) {
    return header.Coefficient * frames * 8 / header.SampleRate;
}

void ApplyVariableBitRate(const MpegHeader& header, std::int64_t frames, std::int64_t bytes,
                          Estimate& estimate) {
    const std::int64_t coefficient = header.Coefficient;
    estimate.FrameCount = frames;
    estimate.FrameSize = (bytes + frames / 2) / frames + header.PaddingBytes();
    estimate.Length = LengthOfFrames(header, frames);
    estimate.BitRate = estimate.FrameSize * header.SampleRate / coefficient / 1000;
}

// A constant stream: the header counts its frames, and its size gives the bit rate. The frame with the header
// is not counted but is part of the bytes.
void ApplyExactConstantBitRate(const MpegHeader& header, std::int64_t frames, std::int64_t bytes,
                               Estimate& estimate) {
    const std::int64_t coefficient = header.Coefficient * 1000;
    const std::int64_t divisor = coefficient * (frames + 1);
    estimate.FrameCount = frames;
    estimate.Length = LengthOfFrames(header, frames);
    estimate.BitRate = (bytes * header.SampleRate + divisor / 2) / divisor;
    estimate.FrameSize = coefficient * estimate.BitRate / header.SampleRate + header.PaddingBytes();
}

void ApplyVbrHeader(const MpegHeader& header, const VbrHeader& vbr, std::int64_t audioBytes,
                    Estimate& estimate) {
    const std::int64_t bytes = vbr.StreamBytes ? std::int64_t{*vbr.StreamBytes} : audioBytes;
    if (vbr.FrameCount == 0) return;
    if (vbr.Type == VbrHeader::Kind::Info)
        ApplyExactConstantBitRate(header, vbr.FrameCount, bytes, estimate);
    else
        ApplyVariableBitRate(header, vbr.FrameCount, bytes, estimate);
}

QString VbrName(VbrHeader::Kind kind) {
    switch (kind) {
        case VbrHeader::Kind::Xing:
            return u"Xing"_s;
        case VbrHeader::Kind::Vbri:
            return u"FhG (VBRI)"_s;
        case VbrHeader::Kind::Info:
            break;
    }
    return {};
}

void StoreHeader(const MpegHeader& header, TID3Tag& tag) {
    tag.MPEGLayer = header.FormatText();
    tag.SampleRate = Saturated<quint16>(header.SampleRate);
    tag.ChannelMode = header.ChannelMode;
    tag.Emphasis = header.Emphasis;
    tag.Private = header.Private;
    tag.Protected = header.Protected;
    tag.Copyrighted = header.Copyrighted;
    tag.Original = header.Original;
    tag.Padding = header.Padding;
}

}  // namespace

int MpegHeader::PaddingBytes() const {
    if (!Padding) return 0;
    return Layer == 1 ? 4 : 1;
}

int MpegHeader::FrameSize() const {
    if (SampleRate == 0) return 0;
    return Coefficient * BitRate * 1000 / SampleRate + PaddingBytes();
}

const QString& MpegHeader::FormatText() const {
    // Built once: the records of a collection share a dozen texts.
    static const auto texts = [] {
        const std::array versions = {u"MPEG 1.0 "_s, u"MPEG 2.0 "_s, u"MPEG 2.5 "_s, u"MPEG ??? "_s};
        const std::array layers = {u"Layer ???"_s, u"Layer I"_s, u"Layer II"_s, u"Layer III"_s};
        std::array<std::array<QString, layers.size()>, versions.size()> result;
        for (std::size_t version = 0; version < versions.size(); ++version)
            for (std::size_t layer = 0; layer < layers.size(); ++layer)
                result[version][layer] = versions[version] + layers[layer];
        return result;
    }();
    const std::size_t row = Version == MpegVersion::Reserved ? 3 : VersionRow(Version);
    return texts[row][static_cast<std::size_t>(Layer)];
}

MpegHeader MpegHeader::DecodeClassic(std::array<std::uint8_t, 4> bytes) {
    MpegHeader header;
    const unsigned sampleRateIndex = (bytes[2] >> 2) & 3u;
    header.Version = kVersions[(bytes[1] >> 3) & 3u];
    header.Layer = (4 - ((bytes[1] >> 1) & 3)) % 4;
    header.Protected = (bytes[1] & 1) == 0;
    header.BitRate = TableBitRate(header.Version, header.Layer, bytes[2] >> 4);
    header.SampleRate = TableSampleRate(header.Version, sampleRateIndex);
    header.Padding = (bytes[2] & 2) != 0;
    header.Private = (bytes[2] & 1) != 0;
    header.ChannelMode = kChannelModes[bytes[3] >> 6];
    header.Copyrighted = (bytes[3] & 8) != 0;
    header.Original = (bytes[3] & 4) != 0;
    header.Emphasis = kEmphases[bytes[3] & 3u];
    if (header.Version == MpegVersion::Mpeg25 && sampleRateIndex == 3) {
        // Such a header is taken for another kind of stream; the bit rate stays that of the MPEG 2.5 row.
        header.Version = MpegVersion::Mpeg2;
        header.Layer = 1;
        header.SampleRate = 24000;
    }
    header.Coefficient = TableCoefficient(header.Version, header.Layer);
    return header;
}

MpegHeader MpegHeader::DecodeModern(std::array<std::uint8_t, 4> bytes) {
    MpegHeader header = DecodeClassic(bytes);
    const auto frame = IsoFrame::Parse(bytes);
    if (!frame || header.Version == MpegVersion::Mpeg1) return header;
    header.BitRate = frame->BitRate;
    header.Coefficient = frame->Coefficient;
    return header;
}

MpegResults AnalyseMpegFrame(ByteSource& stream, std::int64_t position, const MpegRules& rules,
                             TID3Tag& tag) {
    std::array<std::uint8_t, kVbrHeaderSpan> frame{};
    const auto held = stream.ReadAt(position, frame);
    const auto header = rules.DecodeHeader({frame[0], frame[1], frame[2], frame[3]});
    const std::int64_t left = stream.Size() - position;
    // A file that ends within the bytes set aside holds no whole frame: nothing is counted.
    const std::int64_t audioBytes = std::max<std::int64_t>(0, left - kBytesBehindAudio);

    Estimate estimate = ConstantBitRate(header, audioBytes);
    MpegResults results;
    results.VbrMarker = 0;
    if (estimate.FrameSize > 0 && left > kLeastBytesForVbr) {
        if (const auto vbr = rules.FindVbrHeader(ByteSpan(frame).first(held), header)) {
            if (vbr->Type != VbrHeader::Kind::Info) results.VbrMarker = vbr->Marker;
            results.VbrName = VbrName(vbr->Type);
            ApplyVbrHeader(header, *vbr, audioBytes, estimate);
        }
    }

    StoreHeader(header, tag);
    tag.BitRate = Saturated<quint16>(estimate.BitRate);
    tag.Length = Saturated<quint16>(estimate.Length);
    tag.FrameSize = Saturated<quint16>(estimate.FrameSize);
    results.FrameSize = Saturated<qint32>(estimate.FrameSize);
    results.FrameCount = Saturated<qint32>(estimate.FrameCount);
    return results;
}
