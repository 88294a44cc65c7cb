#include "app/dialogs/SuggestionDialog.h"

#include <QAbstractTableModel>
#include <QDialogButtonBox>
#include <QHeaderView>
#include <QPushButton>
#include <QTableView>
#include <QVBoxLayout>

#include "app/dialogs/DecisionButtons.h"
#include "app/views/RowList.h"
#include "app/views/WrappedLabel.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kWidth = 130;  // average characters
constexpr int kHeight = 32;  // lines

}  // namespace

class SuggestionDialog::Rows : public QAbstractTableModel {
 public:
    enum Column { Dropped, Kept, Similarity, Reason, ColumnCount };

    Rows(const TMusicDatabase& database, std::vector<KeepSuggestion> suggestions, QObject* parent)
        : QAbstractTableModel(parent), database_(database), suggestions_(std::move(suggestions)) {
        for (const KeepSuggestion& suggestion : suggestions_)
            isAgreed_.push_back(suggestion.IsSafe() ? 1 : 0);
    }

    std::vector<SongReplacement> Agreed() const {
        std::vector<SongReplacement> agreed;
        for (std::size_t row = 0; row < suggestions_.size(); ++row)
            if (isAgreed_[row] != 0) agreed.push_back(suggestions_[row].Songs);
        return agreed;
    }

    int rowCount(const QModelIndex& parent) const override {
        return parent.isValid() ? 0 : static_cast<int>(suggestions_.size());
    }
    int columnCount(const QModelIndex& parent) const override { return parent.isValid() ? 0 : ColumnCount; }
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override {
        constexpr QStringView kCaptions[] = {u"In den Papierkorb", u"Bleibt", u"Warsch.",
                                             u"Warum er besser ist"};
        if (orientation != Qt::Horizontal || role != Qt::DisplayRole) return {};
        return kCaptions[section].toString();
    }
    Qt::ItemFlags flags(const QModelIndex& index) const override {
        const Qt::ItemFlags flags = QAbstractTableModel::flags(index);
        return index.column() == Dropped ? flags | Qt::ItemIsUserCheckable : flags;
    }
    QVariant data(const QModelIndex& index, int role) const override {
        if (!index.isValid()) return {};
        const auto row = static_cast<std::size_t>(index.row());
        if (role == Qt::CheckStateRole && index.column() == Dropped)
            return isAgreed_[row] != 0 ? Qt::Checked : Qt::Unchecked;
        if (role != Qt::DisplayRole && role != Qt::ToolTipRole) return {};
        const KeepSuggestion& suggestion = suggestions_[row];
        if (index.column() == Similarity) return SimilarityText(suggestion.Percent);
        if (index.column() == Reason) return suggestion.Reason;
        const TID3Tag* song = database_.Songs().Find(index.column() == Dropped ? suggestion.Songs.Dropped
                                                                               : suggestion.Songs.Kept);
        return song != nullptr ? song->FileName : QString();
    }
    bool setData(const QModelIndex& index, const QVariant& value, int role) override {
        if (!index.isValid() || role != Qt::CheckStateRole) return false;
        isAgreed_[static_cast<std::size_t>(index.row())] = value.toInt() == Qt::Checked ? 1 : 0;
        Q_EMIT dataChanged(index, index, {role});
        return true;
    }

 private:
    const TMusicDatabase& database_;
    std::vector<KeepSuggestion> suggestions_;
    std::vector<char> isAgreed_;
};

SuggestionDialog::SuggestionDialog(const TMusicDatabase& database, std::vector<KeepSuggestion> suggestions,
                                   QWidget* parent)
    : QDialog(parent), rows_(new Rows(database, std::move(suggestions), this)) {
    setObjectName(u"suggestionDialog"_s);
    setWindowTitle(u"Vorschlag für alle"_s);
    SetUpLayout();
    connect(rows_, &QAbstractItemModel::dataChanged, this, [this] { ShowCount(); });
    ShowCount();
}

void SuggestionDialog::SetUpLayout() {
    auto* explanation = new WrappedLabel(u"explanation"_s, this);
    explanation->setText(
        u"Von den gezeigten Paaren, deren Längen sich um höchstens %1 Sekunden unterscheiden, bleibt der "
        "bessere Song. Ein Häkchen haben die, deren Namen zu mindestens %2 % gleich sind; setzen Sie es auch "
        "bei anderen, die gehen sollen. Wie oft sie gespielt wurden, wird dem Song angerechnet, der bleibt, "
        "und in der PlayList tritt er an ihre Stelle."_s.arg(kSameLength)
            .arg(KeepSuggestion::kSafePercent));
    auto* table = new QTableView(this);
    table->setModel(rows_);
    table->setAccessibleName(u"Songs, die gehen"_s);
    SetUpRowList(*table);
    table->setSelectionBehavior(QTableView::SelectItems);  // so that the space bar reaches the tick
    table->setSelectionMode(QTableView::SingleSelection);
    table->setTextElideMode(Qt::ElideMiddle);
    table->horizontalHeader()->setSectionResizeMode(QHeaderView::Stretch);
    table->horizontalHeader()->setSectionResizeMode(Rows::Similarity, QHeaderView::ResizeToContents);
    table->horizontalHeader()->setSectionResizeMode(Rows::Reason, QHeaderView::ResizeToContents);
    const DecisionButtons buttons = MakeDecisionButtons(*this, QString());
    discard_ = buttons.Agree;
    discard_->setAutoDefault(false);
    buttons.Cancel->setDefault(true);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(explanation);
    layout->addWidget(table, 1);
    layout->addWidget(buttons.Box);
    resize(kWidth * fontMetrics().averageCharWidth(), kHeight * fontMetrics().height());
}

void SuggestionDialog::ShowCount() {
    const std::size_t count = rows_->Agreed().size();
    discard_->setText(SongCountText(count) + u" in den &Papierkorb"_s);
    discard_->setEnabled(count > 0);
}

std::vector<SongReplacement> SuggestionDialog::Agreed() const {
    return result() == Accepted ? rows_->Agreed() : std::vector<SongReplacement>();
}
