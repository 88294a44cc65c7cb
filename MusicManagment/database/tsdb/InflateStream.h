#pragma once

#include <zlib.h>

#include <algorithm>
#include <cstdint>
#include <vector>

#include "CommonRUKTools/FileSource.h"

// Reads a zlib stream (RFC 1950) that lies in a source, piece by piece through buffers of fixed size.
class InflateStream {
 public:
    // The largest piece that Take() can give.
    static constexpr std::size_t kLargestPiece = 65535;

    // The stream begins at `start`. `source` must live longer.
    InflateStream(ByteSource& source, std::int64_t start);
    ~InflateStream();
    InflateStream(const InflateStream&) = delete;
    InflateStream& operator=(const InflateStream&) = delete;

    // The next `count` bytes, fewer when the stream or the file ends before; valid until the next call.
    // Everything before a damaged place is given first; then it throws EMusicDatabaseException.
    ByteSpan Take(std::size_t count) {
        if (filled_ - position_ < count) Fill(count);
        const ByteSpan rest(output_.data() + position_, filled_ - position_);
        const ByteSpan taken = rest.first(std::min(count, rest.size()));
        position_ += taken.size();
        return taken;
    }

    // Throws EMusicDatabaseException unless the stream ends here, whole and with the right checksum, and the
    // source with it.
    void ExpectEnd();

 private:
    enum class State { Running, Ended, CutOff, Damaged, WrongChecksum };

    void Fill(std::size_t count);
    void Inflate();
    bool FetchInput();
    void ThrowIfDamaged() const;

    ByteSource& source_;
    std::int64_t next_;  // position in the source of what has not been fetched yet
    z_stream zlib_{};
    State state_ = State::Running;
    std::vector<std::uint8_t> input_;
    std::vector<std::uint8_t> output_;
    std::size_t position_ = 0;  // in output_, of the next byte to give
    std::size_t filled_ = 0;    // bytes in output_
};
