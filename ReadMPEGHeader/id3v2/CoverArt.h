#pragma once

#include <QByteArray>
#include <optional>

#include "CommonRUKTools/FileSource.h"

// The image file of the front cover, or else of the first picture, in the ID3v2 tag of a sound file, at its
// head or behind the sound; nothing when there is none, or only the address of one. Looks through the first
// 16 MiB of the tag. Throws EMediumError when the medium fails.
std::optional<QByteArray> ReadCoverArt(ByteSource& source);
