#pragma once

#include <QByteArray>
#include <optional>

#include "CommonRUKTools/FileSource.h"

// The file of the first picture in the ID3v2 tag at the head of a sound file; nothing when there is none, or
// only the address of one. Looks through the first 16 MiB of the tag. Throws EMediumError when the medium
// fails.
std::optional<QByteArray> ReadCoverArt(ByteSource& source);
