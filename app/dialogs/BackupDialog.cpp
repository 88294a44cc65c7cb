#include "app/dialogs/BackupDialog.h"

#include <QDialogButtonBox>
#include <QFormLayout>
#include <QHeaderView>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QTableView>
#include <QVBoxLayout>

#include "CommonRUKTools/CommandRunner.h"
#include "app/dialogs/DecisionButtons.h"
#include "app/views/RowList.h"

using namespace Qt::StringLiterals;

namespace {

using Kind = BackupDecision::Kind;

constexpr int kWidth = 130;        // average characters
constexpr int kHeight = 34;        // lines
constexpr int kCandidateRows = 6;  // lines
constexpr int kKeys = 9;           // candidates that have a key

}  // namespace

BackupDialog::BackupDialog(const TMusicDatabase& database, const std::vector<BackupFile>& files,
                           const std::vector<BackupCandidates>& candidates, const QString& name,
                           QWidget* parent)
    : QDialog(parent),
      database_(database),
      model_(new BackupModel(database, files, candidates, this)),
      name_(new QLineEdit(this)),
      table_(new QTableView(this)),
      candidates_(new QListWidget(this)),
      summary_(new QLabel(this)) {
    setObjectName(u"backupDialog"_s);
    setWindowTitle(u"Songs von einer Backup-CD wieder einlesen"_s);
    SetUpTable();
    SetUpCandidates();
    SetUpLayout(name);
    table_->setCurrentIndex(model_->index(0, 0));
    table_->setFocus();
    ShowSummary();
}

QString BackupDialog::MediumName() const {
    return name_->text().trimmed();
}

void BackupDialog::SetUpTable() {
    table_->setObjectName(u"files"_s);
    table_->setAccessibleName(u"Dateien auf dem Datenträger"_s);
    table_->setModel(model_);
    table_->setItemDelegate(new RowDelegate(table_));
    SetUpRowList(*table_);
    table_->installEventFilter(this);
    QHeaderView& header = *table_->horizontalHeader();
    header.setDefaultAlignment(Qt::AlignLeft | Qt::AlignVCenter);
    header.setSectionResizeMode(QHeaderView::Stretch);
    for (const int column : {BackupModel::OwnFile, BackupModel::Decision})
        header.setSectionResizeMode(column, QHeaderView::ResizeToContents);
    connect(table_->selectionModel(), &QItemSelectionModel::currentRowChanged, this,
            Guarded([this] { ShowCandidates(); }));
}

void BackupDialog::SetUpCandidates() {
    candidates_->setObjectName(u"candidates"_s);
    candidates_->setAccessibleName(u"Songs, die es sein können"_s);
    candidates_->setUniformItemSizes(true);
    candidates_->setMaximumHeight((kCandidateRows + 1) * fontMetrics().lineSpacing() * 4 / 3);
    candidates_->installEventFilter(this);
    connect(candidates_, &QListWidget::itemDoubleClicked, this,
            Guarded([this](QListWidgetItem* item) { TieSelected(candidates_->row(item)); }));
}

void BackupDialog::SetUpLayout(const QString& name) {
    name_->setObjectName(u"name"_s);
    name_->setText(name);
    auto* form = new QFormLayout;
    form->addRow(u"Name des &Mediums:"_s, name_);
    summary_->setObjectName(u"summary"_s);
    summary_->setTextFormat(Qt::PlainText);
    summary_->setWordWrap(true);
    auto* keys = new QLabel(
        u"Tasten: 1 bis 9 verknüpft mit einem der Songs darunter, N nimmt neu auf, 0 überspringt. Ein "
        "verknüpfter Song liegt für die Sammlung auf dem Datenträger; keine Datei wird verändert."_s,
        this);
    keys->setWordWrap(true);
    const DecisionButtons buttons = MakeDecisionButtons(*this, u"&Übernehmen"_s);
    agree_ = buttons.Agree;
    agree_->setAutoDefault(false);
    buttons.Cancel->setAutoDefault(false);
    auto* layout = new QVBoxLayout(this);
    layout->addLayout(form);
    layout->addWidget(table_, 1);
    layout->addWidget(candidates_);
    layout->addWidget(keys);
    layout->addWidget(summary_);
    layout->addWidget(buttons.Box);
    resize(kWidth * fontMetrics().averageCharWidth(), kHeight * fontMetrics().height());
}

void BackupDialog::ShowCandidates() {
    candidates_->clear();
    const int row = table_->currentIndex().row();
    if (row < 0) return;
    int number = 0;
    for (const BackupCandidate& candidate : model_->CandidatesOf(row)) {
        const TID3Tag* song = database_.Songs().Find(candidate.Song);
        const QString key = ++number <= kKeys ? QString::number(number) + u"   "_s : u"     "_s;
        auto* item = new QListWidgetItem(key + (song ? CandidateText(candidate, *song) : QString()));
        if (song != nullptr) item->setToolTip(song->FileName);
        candidates_->addItem(item);
    }
    candidates_->setCurrentRow(model_->TiedCandidate(row));
}

void BackupDialog::ShowSummary() {
    const auto count = [this](Kind kind) {
        return SongCountText(static_cast<std::size_t>(model_->CountOf(kind)));
    };
    summary_->setText(count(Kind::Tie) + u" verknüpfen, "_s + count(Kind::TakeIn) + u" neu aufnehmen, "_s +
                      count(Kind::Skip) + u" überspringen."_s);
    agree_->setEnabled(model_->CountOf(Kind::Skip) < model_->rowCount());
}

void BackupDialog::TieSelected(int candidate) {
    ForSelected([this, candidate](int row) { return model_->Tie(row, static_cast<std::size_t>(candidate)); });
}

void BackupDialog::DecideSelected(Kind kind) {
    ForSelected([this, kind](int row) {
        model_->Decide(row, kind);
        return true;
    });
}

void BackupDialog::ForSelected(const std::function<bool(int row)>& decide) {
    const QModelIndexList rows = table_->selectionModel()->selectedRows();
    bool decided = false;
    for (const QModelIndex& row : rows)
        decided |= decide(row.row());
    ShowSummary();
    ShowCandidates();
    if (rows.size() != 1 || !decided) return;
    const QModelIndex next = rows.front().siblingAtRow(rows.front().row() + 1);
    if (next.isValid()) table_->setCurrentIndex(next);
}

// --- Keys ---

bool BackupDialog::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() != QEvent::KeyPress) return QDialog::eventFilter(watched, event);
    const auto& press = static_cast<const QKeyEvent&>(*event);
    if ((press.modifiers() & ~Qt::KeypadModifier) != Qt::NoModifier)
        return QDialog::eventFilter(watched, event);
    // The list would leave the key to the dialog as well, which takes it for agreement.
    if (watched == candidates_ && (press.key() == Qt::Key_Return || press.key() == Qt::Key_Enter)) {
        if (candidates_->currentRow() >= 0) TieSelected(candidates_->currentRow());
        return true;
    }
    return IsDecision(press.key()) || QDialog::eventFilter(watched, event);
}

bool BackupDialog::IsDecision(int key) {
    if (key >= Qt::Key_1 && key < Qt::Key_1 + kKeys) {
        TieSelected(key - Qt::Key_1);
        return true;
    }
    if (key != Qt::Key_N && key != Qt::Key_0) return false;
    DecideSelected(key == Qt::Key_N ? Kind::TakeIn : Kind::Skip);
    return true;
}
