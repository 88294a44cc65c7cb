#include "MusicManagment/database/tsdb/InflateStream.h"

#include <cstring>
#include <new>
#include <string_view>

#include "MusicManagment/database/MusicManagment.h"

using namespace Qt::StringLiterals;

namespace {

constexpr std::size_t kBuffer = std::size_t{256} * 1024;
static_assert(kBuffer > InflateStream::kLargestPiece);

}  // namespace

InflateStream::InflateStream(ByteSource& source, std::int64_t start)
    : source_(source), next_(start), input_(kBuffer), output_(kBuffer) {
    if (inflateInit(&zlib_) != Z_OK) throw std::bad_alloc();
}

InflateStream::~InflateStream() {
    inflateEnd(&zlib_);
}

void InflateStream::Fill(std::size_t count) {
    const std::size_t rest = filled_ - position_;
    if (rest > 0) std::memmove(output_.data(), output_.data() + position_, rest);
    position_ = 0;
    filled_ = rest;
    while (filled_ < count && state_ == State::Running)
        Inflate();
    if (filled_ < count) ThrowIfDamaged();
}

void InflateStream::Inflate() {
    if (zlib_.avail_in == 0 && !FetchInput()) {
        state_ = State::CutOff;
        return;
    }
    zlib_.next_out = output_.data() + filled_;
    zlib_.avail_out = static_cast<uInt>(output_.size() - filled_);
    const int result = inflate(&zlib_, Z_NO_FLUSH);
    filled_ = output_.size() - zlib_.avail_out;
    if (result == Z_MEM_ERROR) throw std::bad_alloc();
    if (result == Z_STREAM_END) {
        state_ = State::Ended;
    } else if (result != Z_OK && result != Z_BUF_ERROR) {
        const std::string_view reason = zlib_.msg != nullptr ? zlib_.msg : "";
        state_ = reason == "incorrect data check" ? State::WrongChecksum : State::Damaged;
    }
}

bool InflateStream::FetchInput() {
    const std::size_t count = source_.ReadAt(next_, input_);
    next_ += static_cast<std::int64_t>(count);
    zlib_.next_in = input_.data();
    zlib_.avail_in = static_cast<uInt>(count);
    return count > 0;
}

void InflateStream::ThrowIfDamaged() const {
    if (state_ == State::Damaged)
        throw EMusicDatabaseException(u"Fehler in der Datenbank: Die komprimierten Daten sind beschädigt"_s);
    if (state_ == State::WrongChecksum)
        throw EMusicDatabaseException(u"Fehler in der Datenbank: Die Prüfsumme stimmt nicht"_s);
}

void InflateStream::ExpectEnd() {
    if (!Take(1).empty())
        throw EMusicDatabaseException(u"Fehler in der Datenbank: Unbekannte Daten hinter dem letzten Song"_s);
    if (state_ == State::CutOff)
        throw EMusicDatabaseException(u"Fehler in der Datenbank: Unerwartetes Ende"_s);
    if (zlib_.avail_in > 0 || FetchInput())
        throw EMusicDatabaseException(
            u"Fehler in der Datenbank: Unbekannte Daten hinter dem Ende der Datenbank"_s);
}
