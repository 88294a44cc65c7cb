#include "ReadMPEGHeader/id3v2/PictureType.h"

#include <array>

using namespace Qt::StringLiterals;

namespace {

// https://id3.org/id3v2.3.0#APIC, types 0x00 to 0x14. 0x11 is the standard's joke ("a bright coloured fish"),
// which this program has always shown as an important person.
constexpr std::array<const char16_t*, 0x15> kPictureTypes = {
    u"Sonstiges",
    u"32x32 Icon (PNG)",
    u"Icon",
    u"Cover (Vorne)",
    u"Cover (Hinten)",
    u"Innenzettel",
    u"Auf dem Medium",
    u"Haupt-Artist / -Solist",
    u"Artist",
    u"Dirigent",
    u"Band/Orchester",
    u"Composer",
    u"Lyriker",
    u"Aufnahme-Ort",
    u"Während der Aufnahme",
    u"Während des Auftritts",
    u"Movie/Video Screen-Capture",
    u"Wichtige Person",
    u"Abbildung",
    u"Firmenzeichen des Artists/der Band",
    u"Firmenzeichen des Herausgebers/Studios",
};

}  // namespace

QString PictureTypeText(int type) {
    if (type >= 0 && type < static_cast<int>(kPictureTypes.size()))
        return QString::fromUtf16(kPictureTypes[static_cast<std::size_t>(type)]);
    return u"Unbekannt (0x%1 != ox00-ox14 )"_s.arg(type, 2, 16, QChar(u'0'));
}
