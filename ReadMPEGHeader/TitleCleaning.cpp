#include "ReadMPEGHeader/TitleCleaning.h"

#include <QStringView>
#include <algorithm>
#include <array>
#include <span>

namespace {

// Advertising, wherever it stands.
constexpr std::array<QStringView, 2> kJunkParts = {u"www.", u"http:"};
// Place-holders and boasts of whoever ripped the file.
constexpr std::array<QStringView, 5> kJunkTitles = {u"track", u"title", u"ripped by", u"uploaded", u"upped "};
constexpr std::array<QStringView, 5> kJunkArtists = {u"track", u"artist", u"ripped by", u"uploaded",
                                                     u"upped "};

// "ABBA - Waterloo" by ABBA -> "Waterloo". Upper and lower case must agree: "Kiss me" by KISS is a title.
void RemoveArtistPrefix(TID3Tag& tag) {
    if (tag.Artist.isEmpty() || !tag.Title.startsWith(tag.Artist)) return;
    QStringView rest = QStringView(tag.Title).sliced(tag.Artist.size());
    if (rest.isEmpty() || (rest[0] != u' ' && rest[0] != u'\n' && rest[0] != u'\r')) return;
    rest = rest.trimmed();
    if (rest.startsWith(u'-') || rest.startsWith(u'/')) rest = rest.sliced(1);
    tag.Title = rest.trimmed().toString();
}

bool IsJunk(const QString& text, std::span<const QStringView> beginnings) {
    return std::any_of(kJunkParts.begin(), kJunkParts.end(),
                       [&text](auto part) { return text.contains(part, Qt::CaseInsensitive); }) ||
           std::any_of(beginnings.begin(), beginnings.end(),
                       [&text](auto part) { return text.startsWith(part, Qt::CaseInsensitive); });
}

void RemoveJunk(TID3Tag& tag) {
    if (IsJunk(tag.Title, kJunkTitles)) tag.Title.clear();
    if (IsJunk(tag.Artist, kJunkArtists)) tag.Artist.clear();
}

// "(7) Waterloo" -> track 7, "Waterloo". A number that no track can have stays part of the title.
void TakeTrackNumber(TID3Tag& tag) {
    if (tag.Track != 0 || !tag.Title.startsWith(u'(')) return;
    const qsizetype close = tag.Title.indexOf(u')');
    if (close < 0) return;
    const QStringView digits = QStringView(tag.Title).sliced(1, close - 1);
    if (!std::all_of(digits.begin(), digits.end(), [](QChar c) { return c >= u'0' && c <= u'9'; })) return;
    const int number = digits.toInt();
    if (number < 1 || number > 255) return;
    tag.Track = static_cast<quint8>(number);
    tag.Title = tag.Title.sliced(close + 1).trimmed();
}

}  // namespace

void CleanTitles(TID3Tag& tag, const TitleCleaning& cleaning) {
    RemoveArtistPrefix(tag);
    if (cleaning.RemoveJunkTexts) RemoveJunk(tag);
    if (cleaning.TakeTrackNumbers) TakeTrackNumber(tag);
}
