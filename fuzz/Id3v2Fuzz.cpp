#include <QLoggingCategory>
#include <cstdlib>

#include "CommonRUKTools/Errors.h"
#include "ReadMPEGHeader/id3v2/ID3v2Reader.h"

using namespace Qt::StringLiterals;

// The first byte chooses the reader (even: classic) and whether somebody listens (bit 1); the rest is a tag.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    static const bool quiet = [] {
        QLoggingCategory::setFilterRules(u"default.warning=false"_s);  // the decompressor's complaints
        return true;
    }();
    if (!quiet || size == 0) return 0;
    MemorySource source(ByteSpan(data + 1, size - 1));
    qsizetype heard = 0;
    FrameListener listener;
    if ((data[0] & 2) != 0) listener = [&](const FrameReport& report) { heard += report.Text.size(); };
    const auto read = (data[0] & 1) == 0 ? ReadID3v2 : ReadID3v2Modern;
    TID3Tag tag;
    std::optional<XrukFrame> xruk;
    std::int64_t end = -1;
    try {
        const bool found = read(source, 0, end, tag, listener, &xruk);
        if (found && end < 10) std::abort();
    } catch (const EStreamError&) {
        // Damage is an expected outcome, but only the classic rules call it an error, and the tag's end is
        // known as soon as its header is there.
        const bool headerWasCut = source.Size() < 10;
        if (!headerWasCut && (read == ReadID3v2Modern || end < 10)) std::abort();
    }
    return 0;
}
