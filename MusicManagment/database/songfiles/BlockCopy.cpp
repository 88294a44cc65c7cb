#include "MusicManagment/database/songfiles/BlockCopy.h"

#include "CommonRUKTools/Errors.h"

using namespace Qt::StringLiterals;

bool CopyBlocks(ByteSource& source, SafeFile& target, const std::function<bool(std::int64_t done)>& stop) {
    constexpr std::size_t kBlock = 1 << 20;
    std::vector<std::uint8_t> block(kBlock);
    for (std::int64_t done = 0; done < source.Size();) {
        if (stop(done)) return false;
        const auto count = source.ReadAt(done, block);
        if (count == 0) throw EStreamError(u"Unerwartetes Ende der Datei"_s);
        target.Write(ByteSpan(block).first(count));
        done += static_cast<std::int64_t>(count);
    }
    return true;
}
