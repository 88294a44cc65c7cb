#include "ReadMPEGHeader/DisplayTexts.h"

#include <algorithm>
#include <array>

#include "ReadMPEGHeader/Genres.h"

using namespace Qt::StringLiterals;

namespace {

struct NumberText {
    int number;
    const char16_t* text;
};

constexpr std::array<NumberText, 9> kSampleRates = {{
    {0, u"?? kHz"},
    {8000, u"8 kHz"},
    {11025, u"11 kHz"},
    {16000, u"16 kHz"},
    {22050, u"22 kHz"},
    {24000, u"24 kHz"},
    {32000, u"32 kHz"},
    {44100, u"44.1 kHz"},
    {48000, u"48 kHz"},
}};

constexpr std::array<NumberText, 7> kChannelModes = {{
    {1, u"Mono"},
    {2, u"Stereo"},
    {3, u"Joint Stereo"},
    {4, u"2 Channels"},
    {5, u"4 Channels"},
    {6, u"6 Channels"},
    {7, u"8 Channels"},
}};

// "CITT" is spelled so on purpose.
constexpr std::array<NumberText, 3> kEmphases = {{
    {1, u"Keine"},
    {3, u"50/15 microsec"},
    {4, u"CITT j.17"},
}};

constexpr std::array<NumberText, 6> kChannelCounts = {{
    {1, u"Mono"},
    {2, u"Stereo"},
    {4, u"Surround (4.0)"},
    {6, u"Surround (5.1)"},
    {7, u"Surround (6.1)"},
    {8, u"Surround (7.1)"},
}};

// Null when the table has no such number.
template <std::size_t N>
QString TextOf(const std::array<NumberText, N>& table, int number) {
    const auto found = std::ranges::find(table, number, &NumberText::number);
    return found == table.end() ? QString() : QString::fromUtf16(found->text);
}

QString TwoDigits(int number) {
    return u"%1"_s.arg(number, 2, 10, QChar(u'0'));
}

}  // namespace

QString FormatLength(int seconds, bool alwaysClock) {
    if (seconds < 60 && !alwaysClock) return QString::number(seconds) + u" s"_s;
    const QString minutesOfHour =
        seconds < 3600 ? QString::number(seconds / 60) : TwoDigits(seconds / 60 % 60);
    const QString clock = minutesOfHour + u':' + TwoDigits(seconds % 60);
    return seconds < 3600 ? clock : QString::number(seconds / 3600) + u':' + clock;
}

QString FormatBitRate(int kbits) {
    return (kbits == 0 ? u"???"_s : QString::number(kbits)) + u" KBit/s"_s;
}

QString FormatSampleRate(int hertz) {
    const QString known = TextOf(kSampleRates, hertz);
    return known.isNull() ? QString::number(hertz / 1000.0, 'f', 6) + u" kHz"_s : known;
}

QString FormatChannelMode(int mode) {
    const QString known = TextOf(kChannelModes, mode);
    return known.isNull() ? u"Mono/Stereo"_s : known;
}

QString FormatEmphasis(int emphasis) {
    const QString known = TextOf(kEmphases, emphasis);
    return known.isNull() ? u"Unbekannt"_s : known;
}

QString FormatHeaderFlags(const TID3Tag& tag) {
    QString flags;
    if (tag.Private) flags += u"Private, ";
    if (tag.Protected) flags += u"Error P. (CRC), ";
    if (tag.Copyrighted) flags += u"Copyrighted, ";
    if (tag.Original) flags += u"Original, ";
    flags.chop(2);
    return flags;
}

QString FormatChannelCount(int count) {
    const QString known = TextOf(kChannelCounts, count);
    return known.isNull() ? QString::number(count) + u" Kanäle"_s : known;
}

QString ArtistAndTitle(const QString& artist, const QString& title) {
    return artist + u" - "_s + title;
}

QString ArtistAndTitle(const TID3Tag& song) {
    return ArtistAndTitle(song.Artist, song.Title);
}

QString TitleBehindArtist(const QString& artist, const QString& title) {
    return artist.isEmpty() ? title : ArtistAndTitle(artist, title);
}

QString GenreDisplayText(const TID3Tag& tag) {
    const bool isUnknown = MainGenreGenre(tag.MainGenre) == kNoGenre;
    return isUnknown && tag.Genre != kNoGenre ? GenreName(tag.Genre) : MainGenreLongName(tag.MainGenre);
}

bool IsValidYearText(const QString& text) {
    return text.size() == 4 && std::ranges::all_of(text, [](QChar c) {
               return (c >= u'0' && c <= u'9') || (c >= u'A' && c <= u'Z');
           });
}

int ExpandYear(const QString& text) {
    const int year = text.toInt();
    if (year == 0) return 0;
    if (year < 21) return year + 2000;
    return year < 99 ? year + 1900 : year;
}
