#pragma once

#include <QByteArray>
#include <cstdint>

#include "CommonRUKTools/ByteWriter.h"
#include "CommonRUKTools/FileSource.h"
#include "ReadMPEGHeader/ID3Tag.h"

// ID3v1 and ID3v1.1: the last 128 bytes of a file (https://id3.org/ID3v1).
inline constexpr std::size_t kId3v1Size = 128;

// Reads the tag at `position` into a fresh record. True when title and artist are both non-empty.
// Throws EStreamError when fewer than 128 bytes follow.
bool ReadID3v1(ByteSource& stream, std::int64_t position, TID3Tag& tag);

// Appends the 128-byte tag. Texts that are too long are cut in the record as well, so that the record shows
// what the file holds.
void WriteID3v1(ByteWriter& stream, TID3Tag& tag);
