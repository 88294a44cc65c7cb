// What search services may answer: a page, or with 'J' in front JSON.

#include <cstdlib>

#include "HTTPRetrieval/MusicBrainz.h"
#include "HTTPRetrieval/SearchPage.h"

namespace {

// Of the marks that Next goes by.
constexpr qsizetype kShortestHit = sizeof("/list/artistInfo.php\">/list/song.phpg=>") - 1;

void ReadPage(const QByteArray& bytes) {
    SearchPage page(QString::fromUtf8(bytes));
    qsizetype hits = 0;
    while (const auto hit = page.Next()) {
        const auto longest = std::max(hit->Artist.size(), hit->Title.size());
        if (longest > SearchPage::kLongestLink || ++hits * kShortestHit > bytes.size()) std::abort();
    }
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
