#include "ReadMPEGHeader/writing/TagLayout.h"

#include <algorithm>
#include <array>
#include <string_view>

#include "CommonRUKTools/Errors.h"
#include "ReadMPEGHeader/SongFileKinds.h"
#include "ReadMPEGHeader/asf/Asf.h"
#include "ReadMPEGHeader/id3v1/ID3v1.h"
#include "ReadMPEGHeader/id3v2/ID3v2FrameWalk.h"
#include "ReadMPEGHeader/id3v2/ID3v2Position.h"
#include "ReadMPEGHeader/mpeg/FrameSearch.h"
#include "ReadMPEGHeader/mpeg/IsoFrame.h"
#include "ReadMPEGHeader/writing/StoredTag.h"

using namespace Qt::StringLiterals;

namespace {

constexpr auto kOldTagSize = static_cast<std::int64_t>(kId3v1Size);
constexpr std::size_t kHeadSize = 16;

std::vector<std::uint8_t> HeadAt(ByteSource& file, std::int64_t position) {
    std::vector<std::uint8_t> head(kHeadSize);
    head.resize(file.ReadAt(position, head));
    return head;
}

bool StandsAt(ByteSource& file, std::int64_t position, std::string_view mark) {
    return position >= 0 && StartsWith(HeadAt(file, position), mark);
}

// https://wiki.hydrogenaud.io/index.php?title=APE_Tags_Header: the footer is the same with another flag.
constexpr std::int64_t kApeHeaderSize = 32;
constexpr std::uint32_t kApeHasHeader = 0x80000000;
constexpr std::uint32_t kApeIsHeader = 0x20000000;

// The APE tag that ends at `end` and begins at `begin` or behind it.
std::optional<FileRange> ApeTagBefore(ByteSource& file, std::int64_t begin, std::int64_t end) {
    if (end - begin < kApeHeaderSize || !StandsAt(file, end - kApeHeaderSize, "APETAGEX"))
        return std::nullopt;
    const auto footer = file.ReadExactly(end - kApeHeaderSize, kApeHeaderSize);
    ByteReader reader(footer);
    reader.Skip(12);
    const std::int64_t size = reader.U32Le();
    reader.Skip(4);
    const std::uint32_t flags = reader.U32Le();
    const bool hasHeader = (flags & kApeHasHeader) != 0;
    const std::int64_t start = end - size - (hasHeader ? kApeHeaderSize : 0);
    if ((flags & kApeIsHeader) != 0 || size < kApeHeaderSize || start < begin) return std::nullopt;
    if (hasHeader && !StandsAt(file, start, "APETAGEX")) return std::nullopt;
    return FileRange{start, end};
}

// True when the chunk that is the file ends at `position` or before it.
bool IsBehindRiff(ByteSource& file, std::int64_t position) {
    const auto head = HeadAt(file, 0);
    ByteReader reader(head);
    reader.Skip(4);
    const std::int64_t size = reader.U32Le();
    const std::int64_t end = 8 + size;
    return size > 4 && end <= position;
}

// True when the objects of the file end where a tag begins, at `position` or before it.
bool IsBehindAsf(ByteSource& file, std::int64_t position) {
    constexpr std::int64_t kObjectHeader = 24;
    constexpr std::int64_t kSizeAt = 16;
    std::int64_t at = 0;
    while (at < position && !StandsAt(file, at, "ID3")) {
        std::array<std::uint8_t, 8> bytes{};
        if (file.ReadAt(at + kSizeAt, bytes) != bytes.size()) return false;
        const std::uint64_t size = ByteReader(bytes).U64Le();
        if (size < kObjectHeader || size > static_cast<std::uint64_t>(position - at)) return false;
        at += static_cast<std::int64_t>(size);
    }
    return true;
}

// Sound in other containers can look like a stream of MPEG frames.
bool IsForeign(ByteSpan head) {
    using namespace std::string_view_literals;
    constexpr std::array marks = {
        "RIFF"sv,       "RIFX"sv,       "RF64"sv,   "FORM"sv, "OggS"sv,
        "fLaC"sv,       "FLV"sv,        "MThd"sv,   "MAC "sv, "\x1A\x45\xDF\xA3"sv,
        "\0\0\1\xBA"sv, "\0\0\1\xB3"sv, "PK\3\4"sv, "%PDF"sv,
    };
    return std::ranges::any_of(marks, [head](std::string_view mark) { return StartsWith(head, mark); }) ||
           (head.size() > 4 && StartsWith(head.subspan(4), "ftyp")) || IsAsf(head);
}

std::int64_t SkipZeros(ByteSource& file, std::int64_t position) {
    std::array<std::uint8_t, 4096> piece{};
    while (const auto count = file.ReadAt(position, piece)) {
        const auto read = std::span(piece).first(count);
        const auto other = std::ranges::find_if(read, [](std::uint8_t byte) { return byte != 0; });
        position += other - read.begin();
        if (other != read.end()) break;
    }
    return position;
}

bool IsMpegSound(ByteSource& file, std::int64_t begin, const QString& path) {
    const std::int64_t start = SkipZeros(file, begin);
    const auto frame = FindMpegFrame(file, start);
    if (!frame) return false;
    if (frame->Confirmed && frame->Position == start) return true;
    // Rubbish before the first frame, or a single frame, is believed where the name says so as well.
    const SongFileKind* kind = KindOfSongFile(path);
    const bool isNamed = kind != nullptr && kind->IsCollected && kind->Description.isEmpty();
    const auto head = HeadAt(file, start);
    return isNamed && !IsForeign(head) && (frame->Confirmed || IsoFrame::Parse(head).has_value());
}

class LayoutSearch {
 public:
    LayoutSearch(ByteSource& file, const QString& path) : file_(file), path_(path) {}

    TagLayout Run() {
        const auto head = HeadAt(file_, 0);
        layout_.Sound = {0, file_.Size()};
        if (StartsWith(head, "RIFF") &&
            StartsWith(ByteSpan(head).subspan(std::min<std::size_t>(8, head.size())), "WAVE"))
            layout_.Container = TagLayout::Kind::Wave;
        else if (IsAsf(head))
            layout_.Container = TagLayout::Kind::Wma;
        else
            FindLeading();
        FindBehind();
        return std::move(layout_);
    }

 private:
    void FindLeading() {
        if (const auto end = EndOfID3v2Tag(file_, 0)) {
            const auto header = ID3v2Header::Read(file_, 0);
            if (!HasKnownFrameLayout(*header))
                throw EStreamError(u"der ID3v2-Tag hat eine unbekannte Version"_s);
            if (*end > file_.Size())
                throw EStreamError(u"der ID3v2-Tag reicht über das Ende der Datei hinaus"_s);
            AddLeading(0, *end);
            FindStacked();
        }
        if (!IsMpegSound(file_, layout_.Sound.Begin, path_))
            throw EStreamError(u"das ist keine MPEG-, WAV- oder WMA-Datei"_s);
    }

    void AddLeading(std::int64_t position, std::int64_t end) {
        layout_.Tags.push_back(position);
        layout_.Sound.Begin = end;
        layout_.AreLeadingTagsWhole = layout_.AreLeadingTagsWhole && IsWholeTag(file_, position);
    }

    void FindStacked() {
        while (true) {
            const std::int64_t position = layout_.Sound.Begin;
            const auto end = EndOfID3v2Tag(file_, position);
            if (!end || *end > file_.Size()) return;
            const auto header = ID3v2Header::Read(file_, position);
            if (!HasKnownFrameLayout(*header)) return;
            AddLeading(position, *end);
        }
    }

    void FindBehind() {
        while (TakeId3v1() || TakeTrailer() || TakeApe()) {
        }
    }

    bool TakeId3v1() {
        const std::int64_t position = layout_.Sound.End - kOldTagSize;
        if (position < layout_.Sound.Begin || !StandsAt(file_, position, "TAG") || !MayEndAt(position))
            return false;
        if (!layout_.Id3v1) layout_.Id3v1 = position;
        layout_.Sound.End = position;
        return true;
    }

    // In a container such bytes may be sound.
    bool MayEndAt(std::int64_t position) {
        switch (layout_.Container) {
            case TagLayout::Kind::Mpeg:
                return true;
            case TagLayout::Kind::Wave:
                return IsBehindRiff(file_, position);
            case TagLayout::Kind::Wma:
                return IsBehindAsf(file_, position);
        }
        return false;
    }

    bool TakeTrailer() {
        const auto position = TagOfTrailerBefore(file_, layout_.Sound.End);
        // A tag that was put in front later hides the one behind the sound, which would come to light again
        // when that goes.
        return position && (TakeTrailed(*position) || TakeTrailed(*position + layout_.Sound.Begin));
    }

    bool TakeTrailed(std::int64_t position) {
        const std::int64_t end = layout_.Sound.End;
        const auto tagEnd = EndOfID3v2Tag(file_, position);
        if (position < layout_.Sound.Begin || !tagEnd || *tagEnd > end - kTagTrailerSize ||
            !IsWholeTag(file_, position) || SkipZeros(file_, *tagEnd) < end - kTagTrailerSize)
            return false;
        if (FindID3v2Tag(file_) == position)
            layout_.Tags.insert(layout_.Tags.begin(), position);
        else
            layout_.Tags.push_back(position);
        layout_.Sound.End = position;
        return true;
    }

    bool TakeApe() {
        const auto tag = ApeTagBefore(file_, layout_.Sound.Begin, layout_.Sound.End);
        if (!tag) return false;
        layout_.Behind.insert(layout_.Behind.begin(), *tag);
        layout_.Sound.End = tag->Begin;
        return true;
    }

    ByteSource& file_;
    const QString& path_;
    TagLayout layout_;
};

}  // namespace

TagLayout FindTags(ByteSource& file, const QString& path) {
    return LayoutSearch(file, path).Run();
}
