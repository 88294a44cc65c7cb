#include "ReadMPEGHeader/id3v2/CoverArt.h"

#include <algorithm>

#include "ReadMPEGHeader/id3v2/ID3v2FrameBody.h"
#include "ReadMPEGHeader/id3v2/ID3v2FrameWalk.h"

using namespace Qt::StringLiterals;

namespace {

constexpr std::int64_t kLongestTag = 16 * 1024 * 1024;  // what is read of one, and so the largest picture
constexpr std::size_t kImageFormatSize = 3;

// https://id3.org/id3v2.3.0#APIC; version 2.2 has a format of three letters where later ones have a type.
std::optional<QByteArray> PictureOf(FrameBody frame, bool hasImageFormat) {
    frame.ReadEncoding();
    const QString type = hasImageFormat ? frame.Latin(kImageFormatSize) : frame.Latin();
    frame.U8();  // what the picture shows
    if (type == u"-->"_s || !frame.TextHasEnd()) return std::nullopt;
    frame.Text();
    const ByteSpan bytes = frame.Rest();
    if (bytes.empty()) return std::nullopt;
    return QByteArray(reinterpret_cast<const char*>(bytes.data()), static_cast<qsizetype>(bytes.size()));
}

class FirstPicture : public ID3v2FrameSink {
 public:
    std::optional<QByteArray> Bytes;

    bool NeedsBody(std::string_view id) const override { return !Bytes && id == "APIC"; }
    void Take(std::string_view, const QString& shownId, ByteSpan body) override {
        Bytes = PictureOf(FrameBody(body, TextRules::Id3v23), shownId == u"PIC");
    }
    void TakeUnreadable(const QString&, std::int64_t, const QString&) override {}
};

}  // namespace

std::optional<QByteArray> ReadCoverArt(ByteSource& source) {
    const auto begin = static_cast<std::int64_t>(kId3v2HeaderSize);
    if (source.Size() < begin) return std::nullopt;
    const auto header = ID3v2Header::Read(source, 0);
    if (!header) return std::nullopt;
    FirstPicture picture;
    WalkID3v2Frames(source, begin, begin + std::min<std::int64_t>(header->Size, kLongestTag), *header,
                    picture);
    return picture.Bytes;
}
