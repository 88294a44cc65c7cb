#include "app/dialogs/TagsFromNamesDialog.h"

#include "app/dialogs/NamePatternTexts.h"

using namespace Qt::StringLiterals;

namespace {

QString DescriptionOf(const QString& pattern) {
    return FaultOfReading(pattern).value_or(
        u"Mit / davor gelten auch die Ordner: %ARTIST%/%ALBUM%/%TRACKNR% - %TITLE%. Die Endung zählt nicht, "
        "technische Angaben werden überlesen. Die Dateien behalten ihre Namen."_s);
}

}  // namespace

TagsFromNamesDialog::TagsFromNamesDialog(const TMusicDatabase& database, std::vector<SongHandle> songs,
                                         const QString& pattern, QWidget* parent)
    : PatternDialog({.Name = u"tagsFromNamesDialog"_s,
                     .Title = u"Tags aus dem Dateinamen"_s,
                     .Table = u"Dateinamen und was die Felder werden"_s,
                     .Button = u"&Tags übernehmen"_s,
                     .Done = u"geändert"_s},
                    songs.size(), parent),
      database_(database),
      songs_(std::move(songs)) {
    Describe(DescriptionOf);
    Begin(pattern);
}

PatternOutcome TagsFromNamesDialog::Plan(const QString& pattern) {
    plans_.clear();
    if (auto fault = FaultOfReading(pattern)) return {.Fault = std::move(fault)};
    const NameMatcher matcher(pattern);
    fields_ = matcher.Fields();
    folders_ = matcher.Folders();
    plans_ = PlanTagsFromNames(database_, songs_, matcher);
    PatternOutcome outcome{.Columns = {{u"Datei"_s}}, .Rows = plans_.size()};
    for (const SongFieldId id : fields_) {
        const SongField& field = FieldOf(id);
        outcome.Columns.push_back(
            {.Heading = QString::fromUtf16(field.Caption), .Narrow = field.Number != nullptr});
    }
    outcome.Columns.push_back({u"Im Weg"_s});
    for (const PlannedTags& plan : plans_) {
        outcome.Possible += plan.Changes ? 1 : 0;
        outcome.Blocked += plan.Reading.Problem.isEmpty() ? 0 : 1;
    }
    return outcome;
}

QVariant TagsFromNamesDialog::Cell(std::size_t row, int column, int role) const {
    const PlannedTags& plan = plans_[row];
    const TID3Tag* record = database_.Songs().Find(plan.Song);
    if (record == nullptr) return {};  // gone meanwhile
    if (column == 0) return NameCell(record->FileName, role);
    const auto field = static_cast<std::size_t>(column - 1);
    if (field < fields_.size()) return FieldCell(*record, plan, fields_[field], role);
    return role == Qt::DisplayRole || role == Qt::ToolTipRole ? plan.Reading.Problem : QVariant();
}

// With the folders that the pattern looks at.
QVariant TagsFromNamesDialog::NameCell(const QString& path, int role) const {
    if (role == Qt::ToolTipRole) return path;
    if (role != Qt::DisplayRole) return {};
    return IsCdPath(path) ? path : path.section(u'/', -1 - folders_);
}

// What stays as it is is grey.
QVariant TagsFromNamesDialog::FieldCell(const TID3Tag& before, const PlannedTags& plan, SongFieldId id,
                                        int role) const {
    if (!plan.Reading.Problem.isEmpty()) return {};
    const SongField& field = FieldOf(id);
    const QString old = EditText(field, before);
    const QString text = EditText(field, WithNamedFields(before, plan.Reading));
    switch (role) {
        case Qt::DisplayRole:
            return text;
        case Qt::ToolTipRole:
            return text == old ? text : u"%1 (bisher: %2)"_s.arg(text, old.isEmpty() ? u"leer"_s : old);
        case Qt::ForegroundRole:
            return text == old ? palette().color(QPalette::Disabled, QPalette::Text) : QVariant();
        default:
            return {};
    }
}
