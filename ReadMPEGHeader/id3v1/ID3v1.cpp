#include "ReadMPEGHeader/id3v1/ID3v1.h"

#include <algorithm>

#include "CommonRUKTools/CodePage.h"

namespace {

constexpr std::size_t kTitleAt = 3;
constexpr std::size_t kArtistAt = 33;
constexpr std::size_t kAlbumAt = 63;
constexpr std::size_t kYearAt = 93;
constexpr std::size_t kCommentAt = 97;
constexpr std::size_t kTrackMarkAt = 125;  // zero here and a number behind it: ID3v1.1
constexpr std::size_t kTrackAt = 126;
constexpr std::size_t kGenreAt = 127;

constexpr std::size_t kTextSize = 30;
constexpr std::size_t kYearSize = 4;
constexpr std::size_t kCommentSizeWithTrack = 28;

bool IsBlank(std::uint8_t byte) {
    return byte <= 0x20;
}

ByteSpan Trimmed(ByteSpan text) {
    const auto first = std::ranges::find_if_not(text, IsBlank);
    auto last = text.end();
    while (last != first && IsBlank(*(last - 1)))
        --last;
    return {first, last};
}

// The field's text goes on to the first zero byte, wherever that is; only then is it cut to the field's size.
QString ReadField(ByteSpan block, std::size_t offset, std::size_t size) {
    const auto rest = block.subspan(offset);
    const auto length = static_cast<std::size_t>(std::ranges::find(rest, 0) - rest.begin());
    return CodePage::FromLegacy(Trimmed(rest.first(std::min(length, size))));
}

ByteSpan Bytes(const QByteArray& text) {
    return AsBytes({text.constData(), static_cast<std::size_t>(text.size())});
}

// The legacy bytes of `text`, at most `limit` of them. A text that had to be cut becomes what is left of it.
QByteArray CutToField(QString& text, std::size_t limit) {
    const auto size = static_cast<qsizetype>(limit);
    QByteArray bytes = CodePage::ToLegacy(text);
    if (bytes.size() <= size) return bytes;
    // Whole characters are dropped, because a legacy page may use two bytes for one. Two UTF-16 units make at
    // least one byte, so nothing behind twice the limit can be part of the field.
    QString cut = text.left(2 * size);
    while ((bytes = CodePage::ToLegacy(cut)).size() > size)
        cut.chop(cut.size() > 1 && cut.back().isLowSurrogate() ? 2 : 1);
    text = CodePage::FromLegacy(Bytes(bytes));
    return bytes;
}

void PutField(std::span<std::uint8_t> block, std::size_t offset, std::size_t limit, QString& text) {
    const QByteArray bytes = CutToField(text, limit);
    std::ranges::copy(Bytes(bytes), block.begin() + static_cast<std::ptrdiff_t>(offset));
}

}  // namespace

bool ReadID3v1(ByteSource& stream, std::int64_t position, TID3Tag& tag) {
    ResetTag(true, tag, 0);
    const auto block = stream.ReadExactly(position, kId3v1Size);
    tag.Title = ReadField(block, kTitleAt, kTextSize);
    tag.Artist = ReadField(block, kArtistAt, kTextSize);
    tag.Album = ReadField(block, kAlbumAt, kTextSize);
    tag.Year = ReadField(block, kYearAt, kYearSize);
    tag.Comment = ReadField(block, kCommentAt, kTextSize);
    if (block[kTrackMarkAt] == 0) tag.Track = block[kTrackAt];
    tag.Genre = block[kGenreAt];
    return !tag.Title.isEmpty() && !tag.Artist.isEmpty();
}

void WriteID3v1(ByteWriter& stream, TID3Tag& tag) {
    std::array<std::uint8_t, kId3v1Size> block{};
    std::ranges::copy(AsBytes("TAG"), block.begin());
    PutField(block, kTitleAt, kTextSize, tag.Title);
    PutField(block, kArtistAt, kTextSize, tag.Artist);
    PutField(block, kAlbumAt, kTextSize, tag.Album);
    PutField(block, kYearAt, kYearSize, tag.Year);
    PutField(block, kCommentAt, tag.Track == 0 ? kTextSize : kCommentSizeWithTrack, tag.Comment);
    if (tag.Track != 0) block[kTrackAt] = tag.Track;
    block[kGenreAt] = tag.Genre;
    stream.Raw(block);
}
