#include "cli/TagAssignment.h"

#include <algorithm>

#include "cli/Arguments.h"

using namespace Qt::StringLiterals;

namespace {

constexpr QLatin1StringView kTrackTotal{"trackTotal"};

[[noreturn]] void ThrowBadValue(const QString& value, const QString& accepted) {
    throw EUsageError(u"Das Feld kann diesen Wert nicht haben: "_s + value + u". Möglich ist: "_s + accepted);
}

QString NamesOfFields() {
    QStringList names;
    for (const SongField& field : SongFields())
        if (field.Set != nullptr) names << QString::fromLatin1(field.FormName);
    return names.join(u", "_s) + u", "_s + kTrackTotal;
}

const SongField& FieldNamed(const QString& name) {
    const auto found = std::ranges::find_if(SongFields(), [&name](const SongField& field) {
        return field.Set != nullptr && name == QLatin1StringView(field.FormName);
    });
    if (found == SongFields().end())
        throw EUsageError(u"Dieses Feld kann nicht gesetzt werden: "_s + name + u". Möglich sind: "_s +
                          NamesOfFields());
    return *found;
}

int TotalOf(const QString& value) {
    bool isNumber = false;
    const uint total = value.toUInt(&isNumber);
    if (!isNumber || total > 255) ThrowBadValue(value, u"eine Zahl von 0 bis 255"_s);
    return static_cast<int>(total);
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
        if (name == kTrackTotal) {
            trackTotal_ = TotalOf(value);
            continue;
        }
        const SongField& field = FieldNamed(name);
        // So that a bad value is told before anything happens.
        if (!field.Set(trial, value)) ThrowBadValue(value, QStringView(field.Accepts).toString());
        changes_.push_back({&field, value});
    }
}

void TagAssignments::Apply(TID3Tag& record) const {
    for (const Change& change : changes_)
        change.Field->Set(record, change.Value);
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
