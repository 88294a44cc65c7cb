#include "app/dialogs/RenameDialog.h"

#include "app/dialogs/NamePatternTexts.h"

using namespace Qt::StringLiterals;

RenameDialog::RenameDialog(const TMusicDatabase& database, std::vector<SongHandle> songs, QWidget* parent)
    : PatternDialog({.Name = u"renameDialog"_s,
                     .Title = u"Umbenennen nach Muster"_s,
                     .Table = u"Alte und neue Namen"_s,
                     .Button = u"&Umbenennen"_s,
                     .Done = u"umbenannt"_s},
                    songs.size(), parent),
      database_(database),
      songs_(std::move(songs)) {
    Begin(database_.MP3NamePattern());
}

PatternOutcome RenameDialog::Plan(const QString& pattern) {
    plans_.clear();
    if (auto fault = FaultOfPattern(pattern)) return {.Fault = std::move(fault)};
    plans_ = PlanRenames(database_, songs_, pattern);
    const std::size_t possible = PossibleMoves(plans_).size();
    return {.Columns = {{u"Alter Name"_s}, {u"Neuer Name"_s}, {u"Im Weg"_s}},
            .Rows = plans_.size(),
            .Possible = possible,
            .Blocked = plans_.size() - possible};
}

QVariant RenameDialog::Cell(std::size_t row, int column, int role) const {
    if (role != Qt::DisplayRole && role != Qt::ToolTipRole) return {};
    const PlannedRename& plan = plans_[row];
    if (column == Problem) return plan.Problem;
    const QString& path = column == OldName ? plan.From : plan.Move.Target;
    const bool staysInFolder = FolderOf(plan.From) == FolderOf(plan.Move.Target);
    return role == Qt::ToolTipRole || !staysInFolder ? path : path.mid(LastSeparator(path) + 1);
}

std::vector<SongMove> RenameDialog::Moves() const {
    return result() == Accepted ? PossibleMoves(plans_) : std::vector<SongMove>();
}
