// Text files that users write: a menu, or with 'C' in front corrections. What is no such file is refused with
// a message; corrected songs need no further correction.

#include <cstdlib>

#include "CommonRUKTools/Errors.h"
#include "CommonRUKTools/MenuFile.h"
#include "MusicManagment/database/batches/Corrections.h"

namespace {

void ReadAsCorrections(const QString& text) {
    const auto corrections = Corrections::FromText(text);
    for (const QString& line : text.split(u'\n')) {
        TID3Tag song;
        song.Artist = line.section(QStringLiteral(" = "), 0, 0);
        song.Title = song.Artist;
        const auto corrected = corrections.Corrected(song);
        if (corrected && corrections.Corrected(*corrected)) std::abort();
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const QString text = QString::fromUtf8(reinterpret_cast<const char*>(data), static_cast<qsizetype>(size));
    try {
        if (text.startsWith(u'C'))
            ReadAsCorrections(text.mid(1));
        else
            ReadMenuFile(text);
    } catch (const ERukException& refused) {
        if (refused.Message().isEmpty()) std::abort();
    }
    return 0;
}
