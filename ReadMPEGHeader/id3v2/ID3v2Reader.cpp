#include "ReadMPEGHeader/id3v2/ID3v2Reader.h"

#include <algorithm>
#include <string>

#include "CommonRUKTools/Errors.h"
#include "ReadMPEGHeader/id3v2/ID3v2Frames.h"
#include "ReadMPEGHeader/id3v2/ID3v2Header.h"

using namespace Qt::StringLiterals;

namespace {

constexpr std::size_t kFrameHeaderSize = 10;

bool IsPadding(std::string_view id) {
    return id == std::string_view("\0\0\0\0", 4);
}

// Hands over the frames between `position` and `end`, and returns where the last one ended or the padding
// begins. A frame whose size reaches beyond the tag is the last one: so look the sizes of ID3v2.4, which are
// coded in another way, and what stands before such a frame is good. Beyond the file the tag is damaged,
// unless the record wants nothing of that frame.
std::int64_t WalkFrames(ByteSource& stream, std::int64_t position, std::int64_t end, ID3v2Frames& frames) {
    while (end - position >= static_cast<std::int64_t>(kFrameHeaderSize)) {
        const auto header = stream.ReadExactly(position, kFrameHeaderSize);
        ByteReader reader(header);
        const std::string_view id = AsText(reader.Take(4));
        const std::int64_t size = reader.U32Be();
        if (IsPadding(id)) break;
        position += kFrameHeaderSize;
        if (size > stream.Size() - position) {
            if (ID3v2Frames::FillsRecord(id))
                throw EStreamError(u"Ein Frame reicht über das Ende der Datei hinaus"_s);
            frames.TakeUnreadable(QString::fromLatin1(id.data(), 4), size, u"Nicht lesbar"_s);
        } else if (frames.NeedsBody(id)) {
            const auto body =
                stream.ReadExactly(position, static_cast<std::size_t>(std::min(size, end - position)));
            frames.Take(id, QString::fromLatin1(id.data(), 4), body);
        }
        position += size;
    }
    return position;
}

}  // namespace

bool ReadID3v2(ByteSource& stream, std::int64_t position, std::int64_t& endPosition, TID3Tag& tag,
               const FrameListener& listener, std::optional<XrukFrame>* xruk) {
    ResetTag(true, tag, 0);
    const auto header = ID3v2Header::Read(stream, position);
    if (!header) return false;
    const std::int64_t firstFrame = position + static_cast<std::int64_t>(kId3v2HeaderSize);
    endPosition = firstFrame + header->Size;
    ID3v2Frames frames(TextRules::Classic, tag, listener, xruk);
    std::int64_t walked = firstFrame;
    frames.Fill([&] { walked = WalkFrames(stream, firstFrame, endPosition, frames); });
    if (walked < endPosition && endPosition > stream.Size())
        throw EStreamError(u"Unerwartetes Ende der Datei"_s);
    return true;
}
