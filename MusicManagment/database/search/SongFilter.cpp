#include "MusicManagment/database/search/SongFilter.h"

#include <QStringList>
#include <algorithm>
#include <iterator>
#include <limits>
#include <optional>

#include "CommonRUKTools/FoldedText.h"
#include "MusicManagment/database/GroupLists.h"
#include "MusicManagment/database/SongTypes.h"
#include "ReadMPEGHeader/Genres.h"

using namespace Qt::StringLiterals;

namespace {

using Test = std::function<bool(const TID3Tag&)>;
using NumberOf = qint64 (*)(const TID3Tag&);
using TextOf = QString (*)(const TID3Tag&);

struct NumberField {
    QStringView Name;
    NumberOf Value;
};
struct TextField {
    QStringView Name;
    TextOf Value;
};

// The first name of each field is the one that is told the user; the others are understood as well.
constexpr TextField kTexts[] = {
    {u"titel", [](const TID3Tag& song) { return song.Title; }},
    {u"artist", [](const TID3Tag& song) { return song.Artist; }},
    {u"album", [](const TID3Tag& song) { return song.Album; }},
    {u"kommentar", [](const TID3Tag& song) { return song.Comment; }},
    {u"pfad", [](const TID3Tag& song) { return song.FileName; }},
    {u"format", [](const TID3Tag& song) { return song.MPEGLayer; }},
    {u"genre", [](const TID3Tag& song) { return MainGenreLongName(song.MainGenre); }},
    {u"id3genre", [](const TID3Tag& song) { return GenreName(song.Genre); }},
    {u"flag", [](const TID3Tag& song) { return FormatSongFlags(song.Flags); }},
    {u"title", [](const TID3Tag& song) { return song.Title; }},
    {u"interpret", [](const TID3Tag& song) { return song.Artist; }},
    {u"comment", [](const TID3Tag& song) { return song.Comment; }},
    {u"path", [](const TID3Tag& song) { return song.FileName; }},
};

constexpr NumberField kNumbers[] = {
    {u"jahr", [](const TID3Tag& song) -> qint64 { return YearNumber(song.Year); }},
    {u"länge", [](const TID3Tag& song) -> qint64 { return song.Length; }},
    {u"bitrate", [](const TID3Tag& song) -> qint64 { return song.BitRate; }},
    {u"abtastrate", [](const TID3Tag& song) -> qint64 { return song.SampleRate; }},
    {u"track", [](const TID3Tag& song) -> qint64 { return song.Track; }},
    {u"beliebtheit", [](const TID3Tag& song) -> qint64 { return song.PlayCount; }},
    {u"year", [](const TID3Tag& song) -> qint64 { return YearNumber(song.Year); }},
    {u"length", [](const TID3Tag& song) -> qint64 { return song.Length; }},
    {u"laenge", [](const TID3Tag& song) -> qint64 { return song.Length; }},
    {u"samplerate", [](const TID3Tag& song) -> qint64 { return song.SampleRate; }},
    {u"playcount", [](const TID3Tag& song) -> qint64 { return song.PlayCount; }},
};
constexpr std::size_t kToldTexts = 9;
constexpr std::size_t kToldNumbers = 6;

struct Range {
    qint64 Low = std::numeric_limits<qint64>::min();
    qint64 High = std::numeric_limits<qint64>::max();
};

// "215" or "3:35"; nothing when it is no number.
std::optional<qint64> ParseNumber(QStringView text) {
    qint64 total = 0;
    for (const QStringView part : text.split(u':')) {
        bool isNumber = false;
        const qint64 value = part.toLongLong(&isNumber);
        if (!isNumber || value < 0 || total > std::numeric_limits<int>::max()) return std::nullopt;
        total = total * 60 + value;
    }
    return total;
}

std::optional<Range> ParseComparison(QStringView text) {
    const auto bound = [&text](qsizetype length) { return ParseNumber(text.mid(length)); };
    Range range;
    if (text.startsWith(u">=") && bound(2)) return range.Low = *bound(2), range;
    if (text.startsWith(u"<=") && bound(2)) return range.High = *bound(2), range;
    if (text.startsWith(u'>') && bound(1)) return range.Low = *bound(1) + 1, range;
    if (text.startsWith(u'<') && bound(1)) return range.High = *bound(1) - 1, range;
    return std::nullopt;
}

// "1980", "1980..1989", "1980..", "..1989", ">=1980", ...; nothing when it is none of these.
std::optional<Range> ParseRange(QStringView text) {
    if (const auto comparison = ParseComparison(text)) return comparison;
    const qsizetype dots = text.indexOf(u"..");
    if (dots < 0) {
        const auto value = ParseNumber(text.startsWith(u'=') ? text.mid(1) : text);
        return value ? std::optional(Range{*value, *value}) : std::nullopt;
    }
    const QStringView low = text.left(dots);
    const QStringView high = text.mid(dots + 2);
    if (low.isEmpty() && high.isEmpty()) return std::nullopt;
    Range range;
    if (!low.isEmpty()) {
        const auto value = ParseNumber(low);
        if (!value) return std::nullopt;
        range.Low = *value;
    }
    if (!high.isEmpty()) {
        const auto value = ParseNumber(high);
        if (!value) return std::nullopt;
        range.High = *value;
    }
    return range;
}

Test AnywhereTest(const QString& needle) {
    return [needle](const TID3Tag& song) {
        return ContainsFolded(song.Title, needle) || ContainsFolded(song.Artist, needle) ||
               ContainsFolded(song.Album, needle) || ContainsFolded(song.Comment, needle) ||
               ContainsFolded(song.Year, needle) || ContainsFolded(song.FileName, needle);
    };
}

// Nothing when there is no such field, or a field of numbers has no range: then the term is an ordinary word.
std::optional<Test> FieldTest(QStringView name, QStringView value) {
    const QString folded = name.toString().toLower();
    for (const TextField& field : kTexts) {
        if (folded != field.Name) continue;
        return [text = field.Value, needle = FoldText(value)](const TID3Tag& song) {
            return ContainsFolded(text(song), needle);
        };
    }
    const auto range = ParseRange(value);
    if (!range) return std::nullopt;
    for (const NumberField& field : kNumbers) {
        if (folded != field.Name) continue;
        return [number = field.Value, range = *range](const TID3Tag& song) {
            const qint64 held = number(song);
            return held >= range.Low && held <= range.High;
        };
    }
    return std::nullopt;
}

// Words; blanks between quotation marks do not separate, the marks themselves are dropped.
QStringList SplitWords(QStringView text) {
    QStringList words;
    QString word;
    bool quoted = false;
    for (const QChar character : text) {
        if (character == u'"') {
            quoted = !quoted;
        } else if (character.isSpace() && !quoted) {
            if (!word.isEmpty()) words << std::exchange(word, QString());
        } else {
            word += character;
        }
    }
    if (!word.isEmpty()) words << word;
    return words;
}

bool IsFieldName(QStringView name) {
    const QString folded = name.toString().toLower();
    const auto isIt = [&folded](const auto& field) { return folded == field.Name; };
    return std::any_of(std::begin(kTexts), std::end(kTexts), isIt) ||
           std::any_of(std::begin(kNumbers), std::end(kNumbers), isIt);
}

// "3:30" and "c:/" are no attempts at a field.
bool LooksLikeField(QStringView name) {
    return name.size() > 1 && std::all_of(name.begin(), name.end(), [](QChar c) { return c.isLetter(); });
}

// "artist:" or "bitrate:>=" on the way to something: the list is not emptied meanwhile.
bool IsStillBeingTyped(QStringView value) {
    return std::all_of(value.begin(), value.end(), [](QChar c) { return QStringView(u"<>=.").contains(c); });
}

Test WordTest(QStringView word) {
    const qsizetype colon = word.indexOf(u':');
    if (colon <= 0) return AnywhereTest(FoldText(word));
    const QStringView name = word.left(colon);
    const QStringView value = word.mid(colon + 1);
    if (IsFieldName(name) && IsStillBeingTyped(value)) return [](const TID3Tag&) { return true; };
    if (auto test = FieldTest(name, value)) return *std::move(test);
    return AnywhereTest(FoldText(word));
}

}  // namespace

SongFilter SongFilter::Parse(QStringView text) {
    SongFilter filter;
    for (const QString& word : SplitWords(text)) {
        const bool excludes = word.size() > 1 && word.startsWith(u'-');
        filter.terms_.push_back({WordTest(QStringView(word).mid(excludes ? 1 : 0)), excludes});
    }
    return filter;
}

bool SongFilter::Matches(const TID3Tag& song) const {
    return std::all_of(terms_.begin(), terms_.end(),
                       [&song](const Term& term) { return term.Test(song) != term.Excludes; });
}

QStringList SongFilter::UnknownFields(QStringView text) {
    QStringList unknown;
    for (const QString& word : SplitWords(text)) {
        const QStringView term = QStringView(word).mid(word.startsWith(u'-') ? 1 : 0);
        const QStringView name = term.left(std::max<qsizetype>(term.indexOf(u':'), 0));
        if (LooksLikeField(name) && !IsFieldName(name) && !unknown.contains(name)) unknown << name.toString();
    }
    return unknown;
}

QStringList SongFilter::FieldNames() {
    QStringList names;
    for (std::size_t i = 0; i < kToldTexts; ++i)
        names << kTexts[i].Name.toString();
    for (std::size_t i = 0; i < kToldNumbers; ++i)
        names << kNumbers[i].Name.toString();
    return names;
}
