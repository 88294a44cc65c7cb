// What search services may answer: a page, or with 'J' in front JSON. Hits must be within the answer.

#include <cstdlib>

#include "HTTPRetrieval/MusicBrainz.h"
#include "HTTPRetrieval/SearchPage.h"

namespace {

void ReadPage(const QByteArray& bytes) {
    SearchPage page(QString::fromUtf8(bytes));
    qsizetype length = 0;
    while (const auto hit = page.Next())
        length += hit->Artist.size() + hit->Title.size() + 1;
    if (length > bytes.size()) std::abort();
}

void ReadJson(const QByteArray& bytes) {
    const auto hits = ReadMusicBrainz(bytes);
    if (!hits) return;
    for (const SearchHit& hit : *hits)
        if (hit.Title.isEmpty() || hit.Track < 0 || hit.Length < 0 || hit.Length > 0xFFFF) std::abort();
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const QByteArray bytes(reinterpret_cast<const char*>(data), static_cast<qsizetype>(size));
    if (bytes.startsWith('J'))
        ReadJson(bytes.mid(1));
    else
        ReadPage(bytes);
    return 0;
}
