#pragma once

#include <array>
#include <cstdint>

#include "CommonRUKTools/ByteReader.h"
#include "ReadMPEGHeader/ID3Tag.h"

// The numbers of a song as database files and playlists store them: 39 bytes without gaps, little-endian.
inline constexpr std::size_t kPackedRecordSize = 39;

// Sets every field of `song` but its texts. Returns the stored year, 0 when none is known; its decimal form
// is the text of the year.
quint16 ReadPackedRecord(ByteReader& stream, TID3Tag& song);

// A year that is no number is stored as 0, one outside 0 to 65535 as the nearest of these.
std::array<std::uint8_t, kPackedRecordSize> PackedRecord(const TID3Tag& song);
