#include "ReadMPEGHeader/writing/CoverFrames.h"

#include <algorithm>
#include <optional>

#include "CommonRUKTools/CodePage.h"
#include "ReadMPEGHeader/id3v2/ID3v2FrameBody.h"

using namespace Qt::StringLiterals;

namespace {

constexpr std::uint8_t kFrontCover = 3;

ByteSpan BytesOf(const QByteArray& bytes) {
    return AsBytes({bytes.constData(), static_cast<std::size_t>(bytes.size())});
}

std::optional<CoverPicture> CoverOf(const TagFrame& frame) {
    if (frame.Id != "APIC" || !frame.IsReadable()) return std::nullopt;
    FrameBody body(frame.Body(), TextRules::Id3v23);
    body.ReadEncoding();
    CoverPicture picture;
    picture.MimeType = body.Latin();
    if (body.U8() != kFrontCover) return std::nullopt;
    body.Text();
    const ByteSpan bytes = body.Rest();
    picture.Bytes = QByteArray(AsText(bytes).data(), static_cast<qsizetype>(bytes.size()));
    return picture;
}

bool IsCover(const TagFrame& frame) {
    return CoverOf(frame).has_value();
}

TagFrame CoverFrame(const CoverPicture& picture) {
    ByteWriter body;
    body.U8(0);
    body.Raw(BytesOf(picture.MimeType.toLatin1()));
    body.U8(0);
    body.U8(kFrontCover);
    body.U8(0);  // an empty description
    body.Raw(BytesOf(picture.Bytes));
    TagFrame frame;
    frame.Id = "APIC";
    frame.ShownId = u"APIC"_s;
    frame.Stored = body.Bytes();
    return frame;
}

}  // namespace

bool ChangesCovers(const std::vector<TagFrame>& frames, const CoverChange& change) {
    const auto covers = std::ranges::count_if(frames, IsCover);
    const auto* picture = std::get_if<CoverPicture>(&change);
    if (picture == nullptr) return covers > 0;
    return covers != 1 || CoverOf(*std::ranges::find_if(frames, IsCover)) != *picture;
}

void ChangeCovers(std::vector<TagFrame>& frames, const CoverChange& change) {
    if (!ChangesCovers(frames, change)) return;
    const auto first = std::ranges::find_if(frames, IsCover) - frames.begin();
    std::erase_if(frames, IsCover);
    if (const auto* picture = std::get_if<CoverPicture>(&change))
        frames.insert(frames.begin() + std::min<std::ptrdiff_t>(first, std::ssize(frames)),
                      CoverFrame(*picture));
}
