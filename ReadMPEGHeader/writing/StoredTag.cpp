#include "ReadMPEGHeader/writing/StoredTag.h"

#include <algorithm>
#include <array>

#include "CommonRUKTools/Errors.h"
#include "ReadMPEGHeader/id3v2/ID3v2FrameWalk.h"

using namespace Qt::StringLiterals;

namespace {

class FrameCollector : public ID3v2FrameSink {
 public:
    FrameCollector(std::uint8_t version, std::vector<TagFrame>& frames)
        : decoder_(version), frames_(frames) {}

    bool NeedsBody(std::string_view) const override { return true; }
    void Take(std::string_view, const QString&, ByteSpan) override {}
    void TakeUnreadable(const QString&, std::int64_t, const QString&) override {}
    bool TakeStored(const StoredFrame& stored) override {
        TagFrame frame;
        frame.Id = stored.Id;
        frame.ShownId = stored.ShownId;
        frame.StatusFlags = stored.StatusFlags;
        frame.FormatFlags = stored.FormatFlags;
        frame.Stored.assign(stored.Bytes.begin(), stored.Bytes.end());
        frame.IsCoded = !stored.Coding.IsPlain();
        if (frame.IsCoded) frame.Decoded = decoder_.Decode(stored.Coding, stored.Bytes);
        frames_.push_back(std::move(frame));
        return true;
    }

 private:
    FrameDecoder decoder_;
    std::vector<TagFrame>& frames_;
};

bool IsZero(ByteSource& stream, std::int64_t begin, std::int64_t end) {
    std::array<std::uint8_t, 4096> piece{};
    while (begin < end) {
        const auto wanted = std::span(piece).first(
            static_cast<std::size_t>(std::min<std::int64_t>(end - begin, piece.size())));
        if (stream.ReadAt(begin, wanted) != wanted.size()) return false;
        if (std::ranges::any_of(wanted, [](std::uint8_t byte) { return byte != 0; })) return false;
        begin += static_cast<std::int64_t>(wanted.size());
    }
    return true;
}

class RestCheck : public ID3v2FrameSink {
 public:
    bool IsPadding = false;

    bool NeedsBody(std::string_view) const override { return false; }
    void Take(std::string_view, const QString&, ByteSpan) override {}
    void TakeUnreadable(const QString&, std::int64_t, const QString&) override {}
    void TakeRest(ByteSource& stream, std::int64_t begin, std::int64_t end) override {
        IsPadding = IsZero(stream, begin, end);
    }
};

void Walk(ByteSource& file, std::int64_t position, const ID3v2Header& header, ID3v2FrameSink& sink) {
    const std::int64_t begin = position + static_cast<std::int64_t>(kId3v2HeaderSize);
    WalkID3v2Frames(file, begin, begin + header.Size, header, sink);
}

}  // namespace

StoredTag ReadStoredTag(ByteSource& file, std::int64_t position) {
    const auto header = ID3v2Header::Read(file, position);
    if (!header) throw EStreamError(u"Unerwartetes Ende der Datei"_s);
    StoredTag tag{.Version = header->Version};
    FrameCollector collector(header->Version, tag.Frames);
    Walk(file, position, *header, collector);
    return tag;
}

bool IsWholeTag(ByteSource& file, std::int64_t position) {
    const auto header = ID3v2Header::Read(file, position);
    if (!header || !HasKnownFrameLayout(*header)) return false;
    RestCheck check;
    Walk(file, position, *header, check);
    return check.IsPadding;
}
