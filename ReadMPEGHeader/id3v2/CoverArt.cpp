#include "ReadMPEGHeader/id3v2/CoverArt.h"

#include <algorithm>
#include <utility>

#include "ReadMPEGHeader/id3v2/ID3v2FrameBody.h"
#include "ReadMPEGHeader/id3v2/ID3v2FrameWalk.h"
#include "ReadMPEGHeader/id3v2/ID3v2Position.h"

using namespace Qt::StringLiterals;

namespace {

constexpr std::int64_t kLongestTag = 16 * 1024 * 1024;  // what is read of one, and so the largest picture
constexpr std::size_t kImageFormatSize = 3;

constexpr std::uint8_t kFrontCover = 3;

struct Picture {
    std::uint8_t Type = 0;
    QByteArray Bytes{};
};

// https://id3.org/id3v2.3.0#APIC; version 2.2 has a format of three letters where later ones have a type.
std::optional<Picture> PictureOf(FrameBody frame, bool hasImageFormat) {
    frame.ReadEncoding();
    const QString format = hasImageFormat ? frame.Latin(kImageFormatSize) : frame.Latin();
    Picture picture{.Type = frame.U8()};
    if (format == u"-->"_s || !frame.TextHasEnd()) return std::nullopt;
    frame.Text();
    const ByteSpan bytes = frame.Rest();
    if (bytes.empty()) return std::nullopt;
    picture.Bytes = QByteArray(AsText(bytes).data(), static_cast<qsizetype>(bytes.size()));
    return picture;
}

class CoverSearch : public ID3v2FrameSink {
 public:
    std::optional<Picture> Found;

    bool NeedsBody(std::string_view id) const override {
        return id == "APIC" && (!Found || Found->Type != kFrontCover);
    }
    void Take(std::string_view, const QString& shownId, ByteSpan body) override {
        auto picture = PictureOf(FrameBody(body, TextRules::Id3v23), shownId == u"PIC");
        if (picture && (!Found || picture->Type == kFrontCover)) Found = std::move(picture);
    }
    void TakeUnreadable(const QString&, std::int64_t, const QString&) override {}
};

}  // namespace

std::optional<QByteArray> ReadCoverArt(ByteSource& source) {
    const auto position = FindID3v2Tag(source);
    if (!position) return std::nullopt;
    const auto header = ID3v2Header::Read(source, *position);
    if (!header) return std::nullopt;
    const std::int64_t begin = *position + static_cast<std::int64_t>(kId3v2HeaderSize);
    CoverSearch search;
    WalkID3v2Frames(source, begin, begin + std::min<std::int64_t>(header->Size, kLongestTag), *header,
                    search);
    if (!search.Found) return std::nullopt;
    return std::move(search.Found->Bytes);
}
