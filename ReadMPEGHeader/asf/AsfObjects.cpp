#include "ReadMPEGHeader/asf/AsfObjects.h"

#include <algorithm>
#include <span>

namespace {

// A header has some ten objects, seldom fifty. The bound keeps a file of empty objects from being read whole.
constexpr int kMostObjects = 1024;
constexpr std::uint64_t kObjectHeaderSize = 24;

constexpr AsfGuid kAudioMedia = {0x40, 0x9E, 0x69, 0xF8, 0x4D, 0x5B, 0xCF, 0x11,
                                 0xA8, 0xFD, 0x00, 0x80, 0x5F, 0x5C, 0x44, 0x2B};

constexpr std::uint32_t kBroadcastFlag = 1;
constexpr std::uint16_t kEncryptedFlag = 0x8000;
constexpr std::uint16_t kAudioCodec = 2;

void TakeText(QString& field, const QString& text) {
    if (!text.isEmpty()) field = text;
}

bool ReadContentDescription(AsfCursor& body, AsfHeader& header) {
    const auto titleSize = body.U16();
    const auto authorSize = body.U16();
    const auto copyrightSize = body.U16();
    const auto descriptionSize = body.U16();
    body.Skip(2);  // size of the rating, which comes last
    TakeText(header.Info.Title, body.Text(titleSize));
    TakeText(header.Info.Artist, body.Text(authorSize));
    body.Skip(copyrightSize);
    TakeText(header.Info.Comment, body.Text(descriptionSize));
    return !body.Failed();
}

bool ReadExtendedContentDescription(AsfCursor& body, AsfHeader& header) {
    return ReadExtendedContent(body, header.Attributes);
}

bool ReadMetadataObject(AsfCursor& body, AsfHeader& header) {
    return ReadMetadata(body, header.Attributes);
}

bool ReadFileProperties(AsfCursor& body, AsfHeader& header) {
    body.Skip(16 + 8);  // identifier and size of the file
    const auto creationTime = body.U64();
    body.Skip(8);  // number of packets
    const auto playDuration = body.U64();
    body.Skip(8);  // time to send
    header.Info.Preroll = body.U64();
    // A recording that was not finished has no valid times yet.
    const bool finished = (body.U32() & kBroadcastFlag) == 0;
    header.Info.CreationTime = finished ? creationTime : 0;
    header.Info.PlayDuration = finished ? playDuration : 0;
    body.Skip(8);  // packet sizes
    header.MaximumBitRate = body.U32();
    return !body.Failed();
}

// The wave format of the first audio stream.
bool ReadStreamProperties(AsfCursor& body, AsfHeader& header) {
    const bool isAudio = body.Block<16>() == kAudioMedia;
    if (!isAudio || header.HasAudio) return !body.Failed();
    body.Skip(16 + 8);  // error correction, time offset
    const auto formatSize = body.U32();
    body.Skip(4);
    header.Info.Encrypted = (body.U16() & kEncryptedFlag) != 0;
    body.Skip(4);
    AsfCursor format = body.Area(formatSize);
    format.Skip(2);  // codec number
    header.Info.Channels = format.U16();
    header.Info.SampleRate = format.U32();
    const std::uint64_t bitRate = std::uint64_t{8} * format.U32();
    header.Info.BitRate = static_cast<quint32>(std::min<std::uint64_t>(bitRate, UINT32_MAX));
    header.Info.BlockAlign = format.U16();
    header.HasAudio = true;
    return !body.Failed() && !format.Failed();
}

// Name and description of the first audio codec; sizes of texts count UTF-16 units here.
bool ReadCodecList(AsfCursor& body, AsfHeader& header) {
    body.Skip(16);
    for (auto count = body.U32(); count > 0 && !body.Failed() && !header.HasCodec; --count) {
        header.HasCodec = body.U16() == kAudioCodec;
        const QString name = body.Text(2u * body.U16());
        const QString description = body.Text(2u * body.U16());
        body.Skip(body.U16());
        if (!header.HasCodec) continue;
        header.Info.CodecName = name;
        header.Info.CodecDescription = description;
    }
    return !body.Failed();
}

struct ObjectReader {
    AsfGuid guid;
    bool (*read)(AsfCursor& body, AsfHeader& header);
};

constexpr std::array<ObjectReader, 5> kHeaderObjects = {{
    {{0x33, 0x26, 0xB2, 0x75, 0x8E, 0x66, 0xCF, 0x11, 0xA6, 0xD9, 0x00, 0xAA, 0x00, 0x62, 0xCE, 0x6C},
     ReadContentDescription},
    {{0x40, 0xA4, 0xD0, 0xD2, 0x07, 0xE3, 0xD2, 0x11, 0x97, 0xF0, 0x00, 0xA0, 0xC9, 0x5E, 0xA8, 0x50},
     ReadExtendedContentDescription},
    {{0xA1, 0xDC, 0xAB, 0x8C, 0x47, 0xA9, 0xCF, 0x11, 0x8E, 0xE4, 0x00, 0xC0, 0x0C, 0x20, 0x53, 0x65},
     ReadFileProperties},
    {{0x91, 0x07, 0xDC, 0xB7, 0xB7, 0xA9, 0xCF, 0x11, 0x8E, 0xE6, 0x00, 0xC0, 0x0C, 0x20, 0x53, 0x65},
     ReadStreamProperties},
    {{0x40, 0x52, 0xD1, 0x86, 0x1D, 0x31, 0xD0, 0x11, 0xA3, 0xA4, 0x00, 0xA0, 0xC9, 0x03, 0x48, 0xF6},
     ReadCodecList},
}};

constexpr std::array<ObjectReader, 2> kExtensionObjects = {{
    {{0xEA, 0xCB, 0xF8, 0xC5, 0xAF, 0x5B, 0x77, 0x48, 0x84, 0x67, 0xAA, 0x8C, 0x44, 0xFA, 0x4C, 0xCA},
     ReadMetadataObject},
    {{0x94, 0x1C, 0x23, 0x44, 0x98, 0x94, 0xD1, 0x49, 0xA1, 0x41, 0x1D, 0x13, 0x4E, 0x45, 0x70, 0x54},
     ReadMetadataObject},
}};

constexpr AsfGuid kHeaderExtension = {0xB5, 0x03, 0xBF, 0x5F, 0x2E, 0xA9, 0xCF, 0x11,
                                      0x8E, 0xE3, 0x00, 0xC0, 0x0C, 0x20, 0x53, 0x65};

void ReadObject(const ObjectReader& reader, AsfCursor body, AsfHeader& header) {
    AsfHeader changed = header;
    if (!reader.read(body, changed)) return;
    changed.KnowsAnything = true;
    header = std::move(changed);
}

// Hands each object of the area to `take`. A size that cannot be true ends the walk: where the next object
// begins is not known then.
template <typename Take>
void WalkObjects(AsfCursor objects, Take take) {
    for (int count = 0; count < kMostObjects && objects.Remaining() >= kObjectHeaderSize; ++count) {
        const AsfGuid guid = objects.Block<16>();
        const auto size = objects.U64();
        if (size < kObjectHeaderSize || size - kObjectHeaderSize > objects.Remaining()) return;
        take(guid, objects.Area(size - kObjectHeaderSize));
    }
}

void Dispatch(std::span<const ObjectReader> readers, const AsfGuid& guid, const AsfCursor& body,
              AsfHeader& header) {
    for (const auto& reader : readers)
        if (reader.guid == guid) ReadObject(reader, body, header);
}

void ReadHeaderExtension(AsfCursor body, AsfHeader& header) {
    body.Skip(16 + 2);
    const auto size = body.U32();
    WalkObjects(body.Area(std::min<std::uint64_t>(size, body.Remaining())),
                [&header](const AsfGuid& guid, const AsfCursor& inner) {
                    Dispatch(kExtensionObjects, guid, inner, header);
                });
}

}  // namespace

void ReadAsfObjects(AsfCursor objects, AsfHeader& header) {
    WalkObjects(objects, [&header](const AsfGuid& guid, const AsfCursor& body) {
        if (guid == kHeaderExtension)
            ReadHeaderExtension(body, header);
        else
            Dispatch(kHeaderObjects, guid, body, header);
    });
}
