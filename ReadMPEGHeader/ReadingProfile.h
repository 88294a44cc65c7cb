#pragma once

#include <cstdint>
#include <functional>
#include <optional>

#include "CommonRUKTools/FileSource.h"
#include "ReadMPEGHeader/SongReading.h"
#include "ReadMPEGHeader/asf/Asf.h"
#include "ReadMPEGHeader/id3v2/ID3v2Reader.h"
#include "ReadMPEGHeader/mpeg/MpegFrame.h"

// At most so many bytes of a file's head are searched for sound.
inline constexpr std::int64_t kSearchBytes = 256 * 1024;

// Reads the ID3v2 tag at a position and returns the first byte behind it; the position itself when the tag
// could not be read and its end is not known.
using LeadingTagReader = std::function<std::int64_t(std::int64_t position)>;

// How files are understood; one implementation for each value of ReadProfile.
class ReadingProfile {
 public:
    virtual ~ReadingProfile() = default;

    // As ReadID3v2 and ReadID3v2Modern.
    virtual bool ReadTag(ByteSource& stream, std::int64_t position, std::int64_t& endPosition, TID3Tag& tag,
                         const FrameListener& listener, std::optional<XrukFrame>* xruk) const = 0;
    // Position of the first MPEG frame in the head of the file. A tag in front of it is given to `readTag`,
    // at most one.
    virtual std::optional<std::int64_t> FindFirstFrame(ByteSource& stream,
                                                       const LeadingTagReader& readTag) const = 0;
    virtual const MpegRules& FrameRules() const = 0;
    // Which length of a WMA file is shown.
    virtual AsfLength WmaLength() const = 0;
};

const ReadingProfile& ClassicProfile();
const ReadingProfile& ModernProfile();
