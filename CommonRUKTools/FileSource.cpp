#include "CommonRUKTools/FileSource.h"

#include "CommonRUKTools/Errors.h"

using namespace Qt::StringLiterals;

std::vector<std::uint8_t> ByteSource::ReadExactly(std::int64_t position, std::size_t count) {
    const std::int64_t left = position < 0 ? 0 : Size() - position;
    if (left < 0 || static_cast<std::uint64_t>(left) < count)
        throw EStreamError(u"Unerwartetes Ende der Datei"_s);
    std::vector<std::uint8_t> bytes(count);
    if (ReadAt(position, bytes) != count) throw EStreamError(u"Unerwartetes Ende der Datei"_s);
    return bytes;
}

std::size_t MemorySource::ReadAt(std::int64_t position, std::span<std::uint8_t> target) {
    if (position < 0 || position >= Size()) return 0;
    const auto from = bytes_.subspan(static_cast<std::size_t>(position));
    const std::size_t count = std::min(from.size(), target.size());
    if (count > 0) std::memcpy(target.data(), from.data(), count);
    return count;
}
