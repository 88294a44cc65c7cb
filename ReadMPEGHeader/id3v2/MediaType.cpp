#include "ReadMPEGHeader/id3v2/MediaType.h"

#include <QStringList>
#include <algorithm>
#include <array>

namespace {

// A medium or, behind "/", a refinement of one.
struct MediaCode {
    QStringView Medium;
    QStringView Refinement;  // empty for the medium itself
    QStringView Text;
};

// https://id3.org/id3v2.3.0#TMED. Every medium knows "A", the analogue transfer.
constexpr std::array<MediaCode, 61> kMediaCodes = {{
    {u"DIG", u"", u"Unbekanntes digitales Medium"},
    {u"", u"A", u"analog"},
    {u"ANA", u"", u"Unbekanntes analoges Medium"},
    {u"ANA", u"WAC", u"Wachs-Zylinder"},
    {u"ANA", u"8CA", u"8-Spur Kassette"},
    {u"CD", u"", u"CD"},
    {u"CD", u"DD", u"DDD"},
    {u"CD", u"AD", u"ADD"},
    {u"CD", u"AA", u"AAD"},
    {u"LD", u"", u"Laserdisc"},
    {u"TT", u"", u"Drehscheiben-Aufnahme"},
    {u"TT", u"33", u"33.33 upm"},
    {u"TT", u"45", u"45 upm"},
    {u"TT", u"71", u"71.29 upm"},
    {u"TT", u"76", u"76.59 upm"},
    {u"TT", u"78", u"78.26 upm"},
    {u"TT", u"80", u"80 upm"},
    {u"MD", u"", u"MiniDisc"},
    {u"DAT", u"", u"DAT"},
    {u"DAT", u"1", u"Standard, 48 kHz/16 Bit, Linear"},
    {u"DAT", u"2", u"Mode 2, 32 kHz/16 Bit, Linear"},
    {u"DAT", u"3", u"Mode 3, 32 kHz/12 Bit, Nicht linear, Low Speed"},
    {u"DAT", u"4", u"Mode 4, 32 kHz/12 Bit, 4 Channels"},
    {u"DAT", u"5", u"Mode 5, 44.1 kHz/16 Bit, Linear"},
    {u"DAT", u"6", u"Mode 6, 44.1 kHz/16 Bit, \"Wide Track\" Play"},
    {u"DCC", u"", u"DCC"},
    {u"DVD", u"", u"DVD"},
    {u"TV", u"", u"Fernsehen"},
    {u"TV", u"PAL", u"PAL"},
    {u"TV", u"NTSC", u"NTSC"},
    {u"TV", u"SECAM", u"SECAM"},
    {u"VID", u"", u"Video"},
    {u"VID", u"PAL", u"PAL"},
    {u"VID", u"NTSC", u"NTSC"},
    {u"VID", u"SECAM", u"SECAM"},
    {u"VID", u"VHS", u"VHS"},
    {u"VID", u"SVHS", u"S-VHS"},
    {u"VID", u"BETA", u"BETAMAX"},
    {u"RAD", u"", u"Radio"},
    {u"RAD", u"FM", u"FM"},
    {u"RAD", u"AM", u"AM"},
    {u"RAD", u"LW", u"LW"},
    {u"RAD", u"MW", u"MW"},
    {u"TEL", u"", u"Telefon"},
    {u"TEL", u"I", u"ISDN"},
    {u"MC", u"", u"Kassette"},
    {u"MC", u"4", u"4,75 cm/s"},
    {u"MC", u"9", u"9,5 cm/s"},
    {u"MC", u"I", u"Type I (Ferric/Normal)"},
    {u"MC", u"II", u"Type II (Chrome)"},
    {u"MC", u"III", u"Type III (Ferric Chrome)"},
    {u"MC", u"IV", u"Type IV (Metal)"},
    {u"REE", u"", u"Reel"},
    {u"REE", u"9", u"9,5 cm/s"},
    {u"REE", u"19", u"19 cm/s"},
    {u"REE", u"38", u"38 cm/s"},
    {u"REE", u"76", u"76 cm/s"},
    {u"REE", u"I", u"Type I (Ferric/Normal)"},
    {u"REE", u"II", u"Type II (Chrome)"},
    {u"REE", u"III", u"Type III (Ferric Chrome)"},
    {u"REE", u"IV", u"Type IV (Metal)"},
}};

QString CodeText(QStringView medium, QStringView refinement) {
    const auto matches = [&](const MediaCode& row) {
        return row.Refinement == refinement && (row.Medium == medium || row.Medium.isEmpty());
    };
    const auto row = std::ranges::find_if(kMediaCodes, matches);
    if (row != kMediaCodes.end()) return row->Text.toString();
    return (refinement.isEmpty() ? medium : refinement).toString();
}

// "MC/4/II": a medium and its refinements. A text whose first code is unknown is no reference.
QString ReferenceText(QStringView reference) {
    const QList<QStringView> codes = reference.split(u'/');
    const auto isMedium = [&](const MediaCode& row) { return row.Medium == codes.first(); };
    if (codes.first().isEmpty() || std::ranges::none_of(kMediaCodes, isMedium)) return reference.toString();
    QStringList texts{CodeText(codes.first(), {})};
    for (const QStringView code : codes.mid(1))
        texts += CodeText(codes.first(), code);
    return texts.join(u", ");
}

}  // namespace

QString MediaTypeText(const QString& text) {
    QStringList parts;
    QStringView rest = text;
    // "((" stands for a parenthesis of the text itself.
    while (rest.startsWith(u'(') && !rest.startsWith(u"((")) {
        const qsizetype end = rest.indexOf(u')');
        if (end < 0) break;
        parts += ReferenceText(rest.mid(1, end - 1));
        rest = rest.mid(end + 1).trimmed();
    }
    if (rest.startsWith(u"((")) rest = rest.mid(1);
    if (!rest.isEmpty()) parts += ReferenceText(rest);
    return parts.join(u", ");
}
