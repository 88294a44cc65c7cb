#include "MusicManagment/database/search/SongFilter.h"

#include <QStringList>
#include <algorithm>
#include <limits>
#include <optional>

#include "CommonRUKTools/FoldedText.h"
#include "MusicManagment/database/SongFields.h"

using namespace Qt::StringLiterals;

namespace {

using Test = std::function<bool(const TID3Tag&)>;

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
        return std::ranges::any_of(SongFields(), [&](const SongField& field) {
            return field.InPlainSearch && ContainsFolded(field.Text(song), needle);
        });
    };
}

bool HasName(const SongField& field, const QString& name) {
    const auto names = QStringView(field.FilterNames).split(u' ', Qt::SkipEmptyParts);
    return std::ranges::find(names, QStringView(name)) != names.end();
}

// nullptr when there is no such field.
const SongField* FieldNamed(QStringView name) {
    const QString folded = name.toString().toLower();
    const auto found = std::ranges::find_if(
        SongFields(), [&folded](const SongField& field) { return HasName(field, folded); });
    return found != SongFields().end() ? &*found : nullptr;
}

// Nothing when a field of numbers has no range: then the term is an ordinary word.
std::optional<Test> FieldTest(const SongField& field, QStringView value) {
    if (field.Number == nullptr)
        return [&field, needle = FoldText(value)](const TID3Tag& song) {
            return ContainsFolded(SearchedText(field, song), needle);
        };
    const auto range = ParseRange(value);
    if (!range) return std::nullopt;
    return [number = field.Number, range = *range](const TID3Tag& song) {
        const qint64 held = number(song);
        return held >= range.Low && held <= range.High;
    };
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
    const SongField* field = FieldNamed(word.left(colon));
    if (field == nullptr) return AnywhereTest(FoldText(word));
    const QStringView value = word.mid(colon + 1);
    if (IsStillBeingTyped(value)) return [](const TID3Tag&) { return true; };
    if (auto test = FieldTest(*field, value)) return *std::move(test);
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
        if (LooksLikeField(name) && FieldNamed(name) == nullptr && !unknown.contains(name))
            unknown << name.toString();
    }
    return unknown;
}

QStringList SongFilter::FieldNames() {
    QStringList names;
    for (const SongField& field : SongFields()) {
        const auto all = QStringView(field.FilterNames).split(u' ', Qt::SkipEmptyParts);
        if (!all.isEmpty()) names << all.first().toString();
    }
    return names;
}
