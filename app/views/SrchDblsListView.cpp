#include "app/views/SrchDblsListView.h"

#include <QHeaderView>
#include <QKeyEvent>
#include <algorithm>

#include "app/models/DuplicateListModel.h"
#include "app/views/RowList.h"

using namespace Qt::StringLiterals;

namespace {

using Column = DuplicateListModel::Column;

// Pixels on a screen of 96 dots an inch.
constexpr int kWidths[] = {54, 220, 60, 220, 60, 110};
constexpr int kPlainDpi = 96;

struct DecisionKey {
    int Key;
    PairDecision Decision;
};
constexpr DecisionKey kDecisionKeys[] = {{Qt::Key_1, PairDecision::KeepFirst},
                                         {Qt::Key_2, PairDecision::KeepSecond},
                                         {Qt::Key_B, PairDecision::KeepBoth},
                                         {Qt::Key_V, PairDecision::Ban}};

}  // namespace

TSrchDblsListView::TSrchDblsListView(DuplicateListModel& pairs, QWidget* parent)
    : QTableView(parent), pairs_(pairs) {
    setObjectName(u"duplicates"_s);
    setAccessibleName(u"Doppelte Einträge"_s);
    setAccessibleDescription(
        u"1 behält Titel 1, 2 behält Titel 2, B behält beide, V verbannt beide, die Leertaste spielt"_s);
    setModel(&pairs);
    setItemDelegate(new RowDelegate(this));
    SetUpRowList(*this);
    SetUpColumns();
    FollowModel();
}

void TSrchDblsListView::SetUpColumns() {
    QHeaderView* header = horizontalHeader();
    header->setSectionsMovable(true);
    header->setResizeContentsPrecision(0);
    // A header that knew the selection would look through all rows for columns that are selected whole.
    header->setSelectionModel(new QItemSelectionModel(&pairs_, header));
    header->setSortIndicatorClearable(true);  // a third click: as they were found
    sortByColumn(-1, Qt::AscendingOrder);
    setSortingEnabled(true);
    for (int column = 0; column < DuplicateListModel::ColumnCount; ++column)
        setColumnWidth(column, kWidths[column] * logicalDpiX() / kPlainDpi);
    FitCaptions();
    header->moveSection(Column::Group, 0);
    header->setSectionResizeMode(Column::Title1, QHeaderView::Stretch);
    header->setSectionResizeMode(Column::Title2, QHeaderView::Stretch);
    ShowGroups(false);
}

// A caption is never cut, also not by the arrow of the column that is sorted by, for which the size hint of a
// header that can sort leaves room. Columns that the user has made wider stay.
void TSrchDblsListView::FitCaptions() {
    ensurePolished();
    const QHeaderView* header = horizontalHeader();
    for (int column = 0; column < DuplicateListModel::ColumnCount; ++column)
        if (const int least = header->sectionSizeHint(column); columnWidth(column) < least)
            setColumnWidth(column, least);
}

void TSrchDblsListView::ShowGroups(bool shown) {
    setColumnHidden(Column::Group, !shown);
    setAlternatingRowColors(!shown);  // the model tells groups apart by color
}

void TSrchDblsListView::FollowModel() {
    connect(&pairs_, &QAbstractItemModel::modelAboutToBeReset, this, [this] { KeepRow(); });
    connect(&pairs_, &QAbstractItemModel::modelReset, this, [this] { RestoreRow(); });
    connect(&pairs_, &QAbstractItemModel::rowsInserted, this, [this] {
        if (!currentIndex().isValid()) setCurrentIndex(pairs_.index(0, 0));
    });
    connect(selectionModel(), &QItemSelectionModel::currentRowChanged, this,
            [this](const QModelIndex& current) {
                viewport()->update();  // whole rows show the focus
                if (OnRow) OnRow(current.row());
            });
}

void TSrchDblsListView::KeepRow() {
    keptRow_ = currentIndex().row();
    if (keptRow_ >= 0) keptNumber_ = pairs_.NumberAt(keptRow_);
}

// Where the row is not there any more the one that has come in its place.
void TSrchDblsListView::RestoreRow() {
    const int last = pairs_.rowCount() - 1;
    const int found = keptRow_ >= 0 ? pairs_.RowOf(keptNumber_) : -1;
    const int row = found >= 0 ? found : std::min(std::max(keptRow_, 0), last);
    if (row >= 0)
        setCurrentIndex(pairs_.index(row, 0));
    else if (OnRow)
        OnRow(-1);
}

std::vector<int> TSrchDblsListView::ChosenRows() const {
    std::vector<int> rows;
    for (const QItemSelectionRange& range : selectionModel()->selection())
        for (int row = range.top(); row <= range.bottom(); ++row)
            rows.push_back(row);
    if (rows.empty() && currentIndex().isValid()) rows.push_back(currentIndex().row());
    std::ranges::sort(rows);
    return rows;
}

// In a list of rows Home and End go to the first and the last row.
QModelIndex TSrchDblsListView::moveCursor(CursorAction action, Qt::KeyboardModifiers modifiers) {
    if (action == MoveHome) return pairs_.index(0, 0);
    if (action == MoveEnd) return pairs_.index(pairs_.rowCount() - 1, 0);
    return QTableView::moveCursor(action, modifiers);
}

void TSrchDblsListView::keyPressEvent(QKeyEvent* event) {
    const bool isPlain = (event->modifiers() & ~Qt::KeypadModifier) == Qt::NoModifier;
    const auto found = std::ranges::find(kDecisionKeys, event->key(), &DecisionKey::Key);
    if (isPlain && found != std::end(kDecisionKeys)) {
        if (!event->isAutoRepeat() && OnDecision) OnDecision(found->Decision);
        return;
    }
    if (isPlain && event->key() == Qt::Key_Space) {
        if (!event->isAutoRepeat() && OnListen) OnListen();
        return;
    }
    QTableView::keyPressEvent(event);
}

void TSrchDblsListView::changeEvent(QEvent* event) {
    QTableView::changeEvent(event);
    if (event->type() != QEvent::FontChange && event->type() != QEvent::StyleChange) return;
    FitRowsToFont(*this);
    FitCaptions();
}
