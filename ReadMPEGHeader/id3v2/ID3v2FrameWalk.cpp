#include "ReadMPEGHeader/id3v2/ID3v2FrameWalk.h"

#include <algorithm>
#include <array>
#include <optional>
#include <string>

#include "ReadMPEGHeader/id3v2/ID3v2FrameCoding.h"
#include "ReadMPEGHeader/id3v2/ID3v2FrameIds.h"

using namespace Qt::StringLiterals;

namespace {

// Flags of the tag header.
constexpr std::uint8_t kUnsynchronised = 0x80;
constexpr std::uint8_t kExtendedHeader = 0x40;
constexpr std::uint8_t kCompressed22 = 0x40;  // the same bit in version 2.2

constexpr std::int64_t kFrameHeaderSize = 10;
constexpr std::int64_t kFrameHeaderSize22 = 6;

struct FrameHeader {
    std::string Id;   // of ID3v2.3
    QString ShownId;  // as in the tag
    std::int64_t Size = 0;
    FrameCoding Coding;
    std::uint8_t StatusFlags = 0;
    std::uint8_t FormatFlags = 0;
};

// The frames between two positions of a stream, as one version lays them out. Ends at padding and at the
// first frame that cannot be right.
class FrameWalk {
 public:
    FrameWalk(ByteSource& stream, std::int64_t begin, std::int64_t end, const ID3v2Header& tag)
        : stream_(stream), position_(begin), end_(end), tag_(tag), decoder_(tag.Version) {}

    void Run(ID3v2FrameSink& sink) {
        if (tag_.Version > 2 && (tag_.Flags & kExtendedHeader) != 0) SkipExtendedHeader();
        std::int64_t frame = position_;
        for (auto header = NextHeader(); header && header->Size <= end_ - position_; header = NextHeader()) {
            if (sink.NeedsBody(header->Id)) HandOver(*header, sink);
            position_ += header->Size;
            frame = position_;
        }
        sink.TakeRest(stream_, frame, end_);
    }

 private:
    std::int64_t HeaderSize() const { return tag_.Version == 2 ? kFrameHeaderSize22 : kFrameHeaderSize; }

    // The size of version 2.3 leaves its own four bytes out, that of 2.4 counts them.
    void SkipExtendedHeader() {
        if (end_ - position_ < kFrameHeaderSize) return;
        const auto head = stream_.ReadExactly(position_, 4);
        // There are taggers that set the flag and write no such header.
        if (IsFrameId(AsText(head))) return;
        ByteReader reader(head);
        const std::int64_t size = tag_.Version == 4 ? std::max<std::int64_t>(reader.SynchSafe32(), 4)
                                                    : 4 + std::int64_t{reader.U32Be()};
        position_ += std::min(size, end_ - position_);
    }

    // Moves behind the header.
    std::optional<FrameHeader> NextHeader() {
        if (end_ - position_ < HeaderSize()) return std::nullopt;
        const auto bytes = stream_.ReadExactly(position_, static_cast<std::size_t>(HeaderSize()));
        position_ += HeaderSize();
        return tag_.Version == 2 ? ParseHeader22(bytes) : ParseHeader(bytes);
    }

    static std::optional<FrameHeader> ParseHeader22(ByteSpan bytes) {
        ByteReader reader(bytes);
        const std::string_view id = AsText(reader.Take(3));
        if (!IsFrameId(id)) return std::nullopt;
        return FrameHeader{
            SuccessorOfFrameId(id), QString::fromLatin1(id.data(), 3), reader.U24Be(), {}, 0, 0};
    }

    std::optional<FrameHeader> ParseHeader(ByteSpan bytes) {
        ByteReader reader(bytes);
        std::string_view id = AsText(reader.Take(4));
        // Some programs kept the three letters of version 2.2 and filled up.
        if (id[3] == '\0' || id[3] == ' ') id.remove_suffix(1);
        if (!IsFrameId(id)) return std::nullopt;
        FrameHeader header;
        header.Id = id.size() == 3 ? SuccessorOfFrameId(id) : std::string(id);
        header.ShownId = QString::fromLatin1(id.data(), static_cast<qsizetype>(id.size()));
        header.Size = tag_.Version == 4 ? ChooseSize(reader.Take(4)) : reader.U32Be();
        header.StatusFlags = bytes[8];
        header.FormatFlags = bytes[9];
        header.Coding = tag_.Version == 4 ? FrameCoding::FromFlags24(header.FormatFlags)
                                          : FrameCoding::FromFlags23(header.FormatFlags);
        if (tag_.Version == 4 && (tag_.Flags & kUnsynchronised) != 0) header.Coding.Unsynchronised = true;
        return header;
    }

    // The standard of version 2.4 wants seven bits a byte here; well-known programs wrote eight all the same.
    // Whichever number leads to something that can follow a frame is the size.
    std::int64_t ChooseSize(ByteSpan bytes) {
        const std::int64_t safe = ByteReader(bytes).SynchSafe32();
        const std::int64_t plain = ByteReader(bytes).U32Be();
        const bool isPlain = std::ranges::any_of(bytes, [](std::uint8_t byte) { return byte >= 0x80; });
        if (isPlain || (safe != plain && !CanFollow(position_ + safe) && CanFollow(position_ + plain)))
            return plain;
        return safe;
    }

    // True when the tag ends at `position`, or padding or a frame begins there.
    bool CanFollow(std::int64_t position) {
        if (position > end_) return false;
        std::array<std::uint8_t, kFrameHeaderSize> next{};
        const auto count =
            std::min(static_cast<std::size_t>(kFrameHeaderSize), static_cast<std::size_t>(end_ - position));
        const auto head = std::span(next).first(count);
        if (stream_.ReadAt(position, head) < count) return false;
        const bool isPadding = std::ranges::all_of(head, [](std::uint8_t byte) { return byte == 0; });
        return isPadding || (count == next.size() && IsFrameId(AsText(head.first(4))));
    }

    void HandOver(const FrameHeader& header, ID3v2FrameSink& sink) {
        const auto stored = stream_.ReadExactly(position_, static_cast<std::size_t>(header.Size));
        if (sink.TakeStored(
                {header.Id, header.ShownId, header.StatusFlags, header.FormatFlags, header.Coding, stored}))
            return;
        if (header.Coding.IsPlain()) return sink.Take(header.Id, header.ShownId, stored);
        if (const auto body = decoder_.Decode(header.Coding, stored))
            return sink.Take(header.Id, header.ShownId, *body);
        sink.TakeUnreadable(header.ShownId, header.Size,
                            header.Coding.Encrypted ? u"Verschlüsselt"_s : u"Nicht lesbar"_s);
    }

    ByteSource& stream_;
    std::int64_t position_;
    std::int64_t end_;
    ID3v2Header tag_;
    FrameDecoder decoder_;
};

}  // namespace

bool HasKnownFrameLayout(const ID3v2Header& tag) {
    // The compression of a whole tag was announced and never defined.
    if (tag.Version == 2) return (tag.Flags & kCompressed22) == 0;
    return tag.Version == 3 || tag.Version == 4;
}

void WalkID3v2Frames(ByteSource& stream, std::int64_t begin, std::int64_t end, const ID3v2Header& tag,
                     ID3v2FrameSink& sink) {
    end = std::min(end, stream.Size());
    if (begin > end || !HasKnownFrameLayout(tag)) return;
    // From version 2.4 on each frame is unsynchronised for itself.
    if (tag.Version == 4 || (tag.Flags & kUnsynchronised) == 0)
        return FrameWalk(stream, begin, end, tag).Run(sink);
    auto bytes = stream.ReadExactly(begin, static_cast<std::size_t>(end - begin));
    Resynchronise(bytes);
    MemorySource plain(bytes);
    FrameWalk(plain, 0, plain.Size(), tag).Run(sink);
}
