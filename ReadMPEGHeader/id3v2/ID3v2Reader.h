#pragma once

#include <cstdint>
#include <optional>

#include "CommonRUKTools/FileSource.h"
#include "ReadMPEGHeader/ID3Tag.h"
#include "ReadMPEGHeader/id3v2/FrameListener.h"
#include "ReadMPEGHeader/id3v2/XrukFrame.h"

// Reads the ID3v2 tag whose header starts at `position` into a fresh record (https://id3.org/id3v2.3.0, with
// this program's own reading of it: frames follow the 10-byte header directly, sizes are plain 32-bit numbers
// in every version, any encoding but 0 is UTF-16 little-endian). `endPosition` becomes the first byte after
// the tag, also when a frame reaches beyond the file. `xruk`, when given, receives the program's private
// frame. Returns true when a tag was read. Throws EStreamError when something that the record needs, or
// padding, ends beyond the file; `tag` then holds the frames read so far.
bool ReadID3v2(ByteSource& stream, std::int64_t position, std::int64_t& endPosition, TID3Tag& tag,
               const FrameListener& listener, std::optional<XrukFrame>* xruk = nullptr);

// The same for the layouts of ID3v2.2 to 2.4 as their standards describe them: frame sizes of each
// version, extended header, unsynchronisation, compressed frames, encodings 0 to 3, "TDRC" as year, genre by
// number or name. Encrypted frames only go to the listener; a tag of another version is not read. Damage
// costs the frames from there on and is no error, nor is a tag that ends beyond the file.
bool ReadID3v2Modern(ByteSource& stream, std::int64_t position, std::int64_t& endPosition, TID3Tag& tag,
                     const FrameListener& listener, std::optional<XrukFrame>* xruk = nullptr);
