#include "app/dialogs/RenameDialog.h"

#include <QAbstractTableModel>
#include <QDialogButtonBox>
#include <QFileInfo>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QTableView>
#include <QVBoxLayout>

#include "app/dialogs/NamePatternEdit.h"
#include "app/dialogs/NamePatternTexts.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kPauseMs = 250;
constexpr int kWidth = 110;  // average characters
constexpr int kHeight = 28;  // lines

}  // namespace

class RenameDialog::Rows : public QAbstractTableModel {
 public:
    enum Column { OldName, NewName, Problem, ColumnCount };

    using QAbstractTableModel::QAbstractTableModel;

    const std::vector<PlannedRename>& Plans() const { return plans_; }
    void Set(std::vector<PlannedRename> plans) {
        beginResetModel();
        plans_ = std::move(plans);
        endResetModel();
    }

    int rowCount(const QModelIndex& parent) const override {
        return parent.isValid() ? 0 : static_cast<int>(plans_.size());
    }
    int columnCount(const QModelIndex& parent) const override { return parent.isValid() ? 0 : ColumnCount; }
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override {
        if (orientation != Qt::Horizontal || role != Qt::DisplayRole) return {};
        return section == OldName ? u"Alter Name"_s : section == NewName ? u"Neuer Name"_s : u"Im Weg"_s;
    }
    QVariant data(const QModelIndex& index, int role) const override {
        if (!index.isValid() || (role != Qt::DisplayRole && role != Qt::ToolTipRole)) return {};
        const PlannedRename& plan = plans_[static_cast<std::size_t>(index.row())];
        if (index.column() == Problem) return plan.Problem;
        const QString& path = index.column() == OldName ? plan.From : plan.Move.Target;
        const bool staysInFolder = FolderOf(plan.From) == FolderOf(plan.Move.Target);
        return role == Qt::ToolTipRole || !staysInFolder ? path : path.mid(LastSeparator(path) + 1);
    }

 private:
    std::vector<PlannedRename> plans_;
};

RenameDialog::RenameDialog(const TMusicDatabase& database, std::vector<SongHandle> songs, QWidget* parent)
    : QDialog(parent),
      database_(database),
      songs_(std::move(songs)),
      pattern_(new NamePatternEdit(this)),
      rows_(new Rows(this)),
      table_(new QTableView(this)),
      summary_(new QLabel(this)) {
    setObjectName(u"renameDialog"_s);
    setWindowTitle(u"Umbenennen nach Muster"_s);
    SetUpLayout();
    pause_.setSingleShot(true);
    pause_.setInterval(kPauseMs);
    pause_.callOnTimeout(this, [this] { Plan(); });
    connect(&pattern_->Edit(), &QLineEdit::textChanged, this, [this] {
        rename_->setEnabled(false);
        pause_.start();
    });
    pattern_->SetPattern(database_.MP3NamePattern());
    Plan();
}

void RenameDialog::SetUpLayout() {
    table_->setModel(rows_);
    table_->setAccessibleName(u"Alte und neue Namen"_s);
    table_->setSelectionBehavior(QTableView::SelectRows);
    table_->setEditTriggers(QTableView::NoEditTriggers);
    table_->setTabKeyNavigation(false);
    table_->setAlternatingRowColors(true);
    table_->setTextElideMode(Qt::ElideMiddle);
    table_->verticalHeader()->hide();
    table_->horizontalHeader()->setSectionResizeMode(QHeaderView::Stretch);
    summary_->setTextFormat(Qt::PlainText);
    summary_->setWordWrap(true);
    auto* buttons = new QDialogButtonBox(this);
    rename_ = buttons->addButton(u"&Umbenennen"_s, QDialogButtonBox::AcceptRole);
    auto* cancel = buttons->addButton(u"Abbrechen"_s, QDialogButtonBox::RejectRole);
    rename_->setAutoDefault(false);
    cancel->setDefault(true);
    connect(buttons, &QDialogButtonBox::accepted, this, &QDialog::accept);
    connect(buttons, &QDialogButtonBox::rejected, this, &QDialog::reject);
    auto* caption = new QLabel(u"&Muster:"_s, this);
    caption->setBuddy(pattern_);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(caption);
    layout->addWidget(pattern_);
    layout->addWidget(table_, 1);
    layout->addWidget(summary_);
    layout->addWidget(buttons);
    resize(kWidth * fontMetrics().averageCharWidth(), kHeight * fontMetrics().height());
}

void RenameDialog::Plan() {
    pause_.stop();
    const auto fault = FaultOfPattern(pattern_->Pattern());
    rows_->Set(fault ? std::vector<PlannedRename>() : PlanRenames(database_, songs_, pattern_->Pattern()));
    const std::size_t planned = rows_->Plans().size();
    const std::size_t possible = PossibleMoves(rows_->Plans()).size();
    QString text =
        SongCountText(possible) + u" von "_s + SongCountText(songs_.size()) + u" wird umbenannt."_s;
    if (possible != 1) text.replace(u" wird "_s, u" werden "_s);
    if (planned > possible)
        text += u" Bei "_s + QString::number(planned - possible) + u" ist etwas im Weg."_s;
    summary_->setText(fault.value_or(text));
    rename_->setEnabled(possible > 0);
}

std::vector<SongMove> RenameDialog::Moves() const {
    return result() == Accepted ? PossibleMoves(rows_->Plans()) : std::vector<SongMove>();
}
