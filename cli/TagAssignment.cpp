#include "cli/TagAssignment.h"

#include <algorithm>
#include <limits>

#include "MusicManagment/database/SongFields.h"
#include "ReadMPEGHeader/Genres.h"
#include "cli/Arguments.h"

using namespace Qt::StringLiterals;

namespace {

[[noreturn]] void ThrowBadValue(const QString& value) {
    throw EUsageError(u"Das Feld kann diesen Wert nicht haben: "_s + value);
}

template <typename Number>
Number NumberOf(const QString& value, Number most = std::numeric_limits<Number>::max()) {
    bool isNumber = false;
    const uint number = value.toUInt(&isNumber);
    if (!isNumber || number > most) ThrowBadValue(value);
    return static_cast<Number>(number);
}

quint8 GenreOf(const QString& value) {
    if (const auto genre = GenreByName(value)) return *genre;
    return NumberOf<quint8>(value);
}

quint8 MainGenreOf(const QString& value) {
    for (int index = 0; index < kMainGenreCount; ++index)
        for (const QString& name : {MainGenreName(index), MainGenreLongName(index)})
            if (name.compare(value, Qt::CaseInsensitive) == 0) return static_cast<quint8>(index);
    return NumberOf<quint8>(value, kMainGenreCount - 1);
}

bool TruthOf(const QString& value) {
    static const QStringList yes{u"true"_s, u"ja"_s, u"1"_s};
    static const QStringList no{u"false"_s, u"nein"_s, u"0"_s};
    if (yes.contains(value, Qt::CaseInsensitive)) return true;
    if (!no.contains(value, Qt::CaseInsensitive)) ThrowBadValue(value);
    return false;
}

quint32 FlagsOf(const QString& value) {
    bool isNumber = false;
    const quint32 number = value.toUInt(&isNumber);
    if (isNumber) return number;
    quint32 flags = 0;
    for (const QString& name : value.split(u',', Qt::SkipEmptyParts)) {
        const QStringList names = SongFlagNames();
        const auto flag = std::ranges::find_if(names, [&name](const QString& known) {
            return known.compare(name.trimmed(), Qt::CaseInsensitive) == 0;
        });
        if (flag == names.end()) ThrowBadValue(value);
        flags |= 1u << (flag - names.begin());
    }
    return flags;
}

// Four digits, as a record holds a year; nothing gives none.
QString YearOf(const QString& value) {
    const bool isYear =
        value.size() == 4 && std::ranges::all_of(value, [](QChar c) { return c >= u'0' && c <= u'9'; });
    if (!isYear && !value.isEmpty()) ThrowBadValue(value);
    return value;
}

struct SettableField {
    const char* Name;
    void (*Set)(TID3Tag& record, const QString& value);
};

constexpr SettableField kFields[] = {
    {"title", [](TID3Tag& record, const QString& value) { record.Title = value; }},
    {"artist", [](TID3Tag& record, const QString& value) { record.Artist = value; }},
    {"album", [](TID3Tag& record, const QString& value) { record.Album = value; }},
    {"year", [](TID3Tag& record, const QString& value) { record.Year = YearOf(value); }},
    {"comment", [](TID3Tag& record, const QString& value) { record.Comment = value; }},
    {"track", [](TID3Tag& record, const QString& value) { record.Track = NumberOf<quint8>(value); }},
    {"genre", [](TID3Tag& record, const QString& value) { record.Genre = GenreOf(value); }},
    {"mainGenre", [](TID3Tag& record, const QString& value) { record.MainGenre = MainGenreOf(value); }},
    {"remix", [](TID3Tag& record, const QString& value) { record.Remix = TruthOf(value); }},
    {"flags", [](TID3Tag& record, const QString& value) { record.Flags = FlagsOf(value); }},
    {"playCount", [](TID3Tag& record, const QString& value) { record.PlayCount = NumberOf<quint32>(value); }},
};

QString NamesOfFields() {
    QStringList names;
    for (const SettableField& field : kFields)
        names << QString::fromLatin1(field.Name);
    return names.join(u", "_s) + u", trackTotal"_s;
}

const SettableField& FieldNamed(const QString& name) {
    const auto found = std::ranges::find_if(
        kFields, [&name](const SettableField& field) { return name == QLatin1StringView(field.Name); });
    if (found == std::end(kFields))
        throw EUsageError(u"Dieses Feld kann nicht gesetzt werden: "_s + name + u". Möglich sind: "_s +
                          NamesOfFields());
    return *found;
}

QString TextOf(const TID3Tag& record, const SongMember& member) {
    return std::visit(
        [&record](auto field) -> QString {
            using Value = std::remove_cvref_t<decltype(record.*field)>;
            if constexpr (std::is_same_v<Value, QString>)
                return record.*field;
            else if constexpr (std::is_same_v<Value, bool>)
                return record.*field ? u"true"_s : u"false"_s;
            else
                return QString::number(record.*field);
        },
        member);
}

}  // namespace

TagAssignments::TagAssignments(const QStringList& assignments) {
    TID3Tag trial;
    for (const QString& assignment : assignments) {
        const qsizetype equals = assignment.indexOf(u'=');
        if (equals < 0) throw EUsageError(u"Erwartet wird FELD=WERT: "_s + assignment);
        const QString name = assignment.left(equals);
        const QString value = assignment.mid(equals + 1);
        if (name == u"trackTotal"_s) {
            trackTotal_ = NumberOf<quint8>(value);
            continue;
        }
        changes_.push_back({FieldNamed(name).Set, value});
        changes_.back().Set(trial, value);  // so that a bad value is told before anything happens
    }
}

void TagAssignments::Apply(TID3Tag& record) const {
    for (const Change& change : changes_)
        change.Set(record, change.Value);
}

std::vector<FieldDifference> DifferencesOf(const TID3Tag& before, const TID3Tag& after) {
    std::vector<FieldDifference> differences;
    for (const RecordMember& row : RecordMembers()) {
        QString old = TextOf(before, row.Member);
        QString now = TextOf(after, row.Member);
        if (old != now) differences.push_back({row.Name, std::move(old), std::move(now)});
    }
    return differences;
}
