#pragma once

#include <zlib.h>

#include <cstdint>
#include <vector>

#include "CommonRUKTools/SafeFile.h"

// Writes a zlib stream (RFC 1950) into a file, piece by piece through a buffer of fixed size.
class DeflateStream {
 public:
    // `level`: 0 none, 1 fastest, -1 default, 9 best. `file` must live longer.
    DeflateStream(SafeFile& file, int level);
    ~DeflateStream();
    DeflateStream(const DeflateStream&) = delete;
    DeflateStream& operator=(const DeflateStream&) = delete;

    // Both throw EStreamError when the file cannot be written.
    void Write(ByteSpan bytes);
    void Finish();

 private:
    void Deflate(ByteSpan bytes, int flush);

    SafeFile& file_;
    z_stream zlib_{};
    std::vector<std::uint8_t> output_;
};
