#include "MusicManagment/database/tsdb/DeflateStream.h"

#include <new>

namespace {

constexpr std::size_t kInput = std::size_t{64} * 1024;
constexpr std::size_t kOutput = std::size_t{256} * 1024;

}  // namespace

DeflateStream::DeflateStream(SafeFile& file, int level) : file_(file), input_(kInput), output_(kOutput) {
    if (deflateInit(&zlib_, level) != Z_OK) throw std::bad_alloc();
    zlib_.next_out = output_.data();
    zlib_.avail_out = static_cast<uInt>(output_.size());
}

DeflateStream::~DeflateStream() {
    deflateEnd(&zlib_);
}

void DeflateStream::MakeSpace(std::size_t count) {
    Deflate(Z_NO_FLUSH);
    if (input_.size() < count) input_.resize(count);
}

void DeflateStream::Finish() {
    Deflate(Z_FINISH);
    file_.Write(ByteSpan(output_).first(output_.size() - zlib_.avail_out));
}

void DeflateStream::Deflate(int flush) {
    zlib_.next_in = input_.data();
    zlib_.avail_in = static_cast<uInt>(gathered_);
    gathered_ = 0;
    while (true) {
        const int result = deflate(&zlib_, flush);
        if (zlib_.avail_out > 0 && (flush == Z_NO_FLUSH || result == Z_STREAM_END)) return;
        file_.Write(output_);
        zlib_.next_out = output_.data();
        zlib_.avail_out = static_cast<uInt>(output_.size());
        if (result == Z_STREAM_END) return;
    }
}
