#include "app/dialogs/PatternDialog.h"

#include <QAbstractTableModel>
#include <QDialogButtonBox>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QTableView>
#include <QVBoxLayout>

#include "CommonRUKTools/CommandRunner.h"
#include "MusicManagment/database/SongTypes.h"
#include "app/dialogs/DecisionButtons.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kPauseMs = 250;
constexpr int kWidth = 130;  // average characters
constexpr int kHeight = 28;  // lines

}  // namespace

class PatternDialog::Rows : public QAbstractTableModel {
 public:
    explicit Rows(PatternDialog& dialog) : QAbstractTableModel(&dialog), dialog_(dialog) {}

    void Renew(const std::function<PatternOutcome()>& plan) {
        beginResetModel();
        outcome_ = {};
        try {
            outcome_ = plan();
        } catch (...) {
            endResetModel();
            throw;
        }
        endResetModel();
    }
    const PatternOutcome& Outcome() const { return outcome_; }

    int rowCount(const QModelIndex& parent) const override {
        return parent.isValid() ? 0 : static_cast<int>(outcome_.Rows);
    }
    int columnCount(const QModelIndex& parent) const override {
        return parent.isValid() ? 0 : static_cast<int>(outcome_.Columns.size());
    }
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override {
        if (orientation != Qt::Horizontal || role != Qt::DisplayRole) return {};
        return outcome_.Columns[static_cast<std::size_t>(section)].Heading;
    }
    QVariant data(const QModelIndex& index, int role) const override {
        if (!index.isValid()) return {};
        return dialog_.Cell(static_cast<std::size_t>(index.row()), index.column(), role);
    }

 private:
    const PatternDialog& dialog_;
    PatternOutcome outcome_;
};

PatternDialog::PatternDialog(Texts texts, std::size_t songs, QWidget* parent)
    : QDialog(parent),
      texts_(std::move(texts)),
      songs_(songs),
      pattern_(new NamePatternEdit(this)),
      rows_(new Rows(*this)),
      table_(new QTableView(this)),
      summary_(new QLabel(this)) {
    setObjectName(texts_.Name);
    setWindowTitle(texts_.Title);
    SetUpLayout();
    pause_.setSingleShot(true);
    pause_.setInterval(kPauseMs);
    pause_.callOnTimeout(this, Guarded([this] { Show(); }));
    connect(&pattern_->Edit(), &QLineEdit::textChanged, this, Guarded([this] {
        agree_->setEnabled(false);
        pause_.start();
    }));
}

void PatternDialog::SetUpLayout() {
    table_->setModel(rows_);
    table_->setAccessibleName(texts_.Table);
    table_->setSelectionBehavior(QTableView::SelectRows);
    table_->setEditTriggers(QTableView::NoEditTriggers);
    table_->setTabKeyNavigation(false);
    table_->setAlternatingRowColors(true);
    table_->setTextElideMode(Qt::ElideMiddle);
    table_->setWordWrap(false);
    table_->verticalHeader()->hide();
    table_->horizontalHeader()->setHighlightSections(false);
    table_->horizontalHeader()->setDefaultAlignment(Qt::AlignLeft | Qt::AlignVCenter);
    summary_->setObjectName(u"summary"_s);
    summary_->setTextFormat(Qt::PlainText);
    summary_->setWordWrap(true);
    const DecisionButtons buttons = MakeDecisionButtons(*this, texts_.Button);
    agree_ = buttons.Agree;
    agree_->setAutoDefault(false);
    buttons.Cancel->setDefault(true);
    auto* caption = new QLabel(u"&Muster:"_s, this);
    caption->setBuddy(pattern_);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(caption);
    layout->addWidget(pattern_);
    layout->addWidget(table_, 1);
    layout->addWidget(summary_);
    layout->addWidget(buttons.Box);
    resize(kWidth * fontMetrics().averageCharWidth(), kHeight * fontMetrics().height());
}

void PatternDialog::Begin(const QString& pattern) {
    pattern_->SetPattern(pattern);
    Show();
}

void PatternDialog::Describe(NamePatternEdit::Description description) {
    pattern_->SetDescription(std::move(description));
}

void PatternDialog::Show() {
    pause_.stop();
    rows_->Renew([this] { return Plan(Pattern()); });
    const PatternOutcome& outcome = rows_->Outcome();
    for (int column = 0; const PatternColumn& each : outcome.Columns)
        table_->horizontalHeader()->setSectionResizeMode(
            column++, each.Narrow ? QHeaderView::ResizeToContents : QHeaderView::Stretch);
    summary_->setText(outcome.Fault ? QString() : Summary(outcome));
    agree_->setEnabled(!outcome.Fault && outcome.Possible > 0);
}

QString PatternDialog::Summary(const PatternOutcome& outcome) const {
    const QString verb = outcome.Possible == 1 ? u" wird "_s : u" werden "_s;
    QString text = SongCountText(outcome.Possible) + u" von "_s + SongCountText(songs_) + verb + texts_.Done;
    text += u'.';
    if (outcome.Blocked > 0) text += u" Bei %1 ist etwas im Weg."_s.arg(outcome.Blocked);
    return text;
}
