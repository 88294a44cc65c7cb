#pragma once

#include <zlib.h>

#include <cstdint>
#include <cstring>
#include <span>
#include <vector>

#include "CommonRUKTools/SafeFile.h"

// Writes a zlib stream (RFC 1950) into a file, piece by piece through buffers of fixed size.
class DeflateStream {
 public:
    // `level`: 0 none, 1 fastest, -1 default, 9 best. `file` must live longer.
    DeflateStream(SafeFile& file, int level);
    ~DeflateStream();
    DeflateStream(const DeflateStream&) = delete;
    DeflateStream& operator=(const DeflateStream&) = delete;

    // Room for the next `count` bytes at least, to be filled in place and then added. What was added before
    // may move. Throws EStreamError when the file cannot be written, as the others do.
    std::span<std::uint8_t> Space(std::size_t count) {
        if (input_.size() - gathered_ < count) MakeSpace(count);
        return std::span(input_).subspan(gathered_);
    }
    void Add(std::size_t count) { gathered_ += count; }

    void Write(ByteSpan bytes) {
        if (bytes.empty()) return;
        std::memcpy(Space(bytes.size()).data(), bytes.data(), bytes.size());
        Add(bytes.size());
    }
    void Finish();

 private:
    void MakeSpace(std::size_t count);
    void Deflate(int flush);

    SafeFile& file_;
    z_stream zlib_{};
    std::vector<std::uint8_t> input_;
    std::size_t gathered_ = 0;  // bytes in input_ that wait to be compressed
    std::vector<std::uint8_t> output_;
};
