#include "app/views/SongListWidget.h"

#include <QApplication>
#include <QHeaderView>
#include <QScopedValueRollback>
#include <QScrollBar>
#include <QStyledItemDelegate>

#include "MusicManagment/database/MusicManagment.h"
#include "app/CommandRunner.h"
#include "app/models/SongColumns.h"
#include "app/models/SongListModel.h"

using namespace Qt::StringLiterals;

namespace {

// Rows are chosen whole, so no single cell shows the focus; a focused row that is not selected does.
class RowDelegate : public QStyledItemDelegate {
 public:
    using QStyledItemDelegate::QStyledItemDelegate;

 protected:
    void initStyleOption(QStyleOptionViewItem* option, const QModelIndex& index) const override {
        QStyledItemDelegate::initStyleOption(option, index);
        option->state &= ~QStyle::State_HasFocus;
        const auto* view = qobject_cast<const QAbstractItemView*>(option->widget);
        if (view == nullptr || !view->hasFocus() || (option->state & QStyle::State_Selected) != 0) return;
        if (view->currentIndex().row() == index.row()) option->state |= QStyle::State_HasFocus;
    }
};

class WaitCursor {
 public:
    WaitCursor() { QApplication::setOverrideCursor(Qt::WaitCursor); }
    ~WaitCursor() { QApplication::restoreOverrideCursor(); }
    WaitCursor(const WaitCursor&) = delete;
    WaitCursor& operator=(const WaitCursor&) = delete;
};

}  // namespace

SongListWidget::SongListWidget(SongListModel& model, TMusicDatabase& database, QWidget* parent)
    : QTableView(parent), model_(model), database_(database) {
    setObjectName(u"songList"_s);
    setAccessibleName(u"Songs"_s);
    setModel(&model);
    setItemDelegate(new RowDelegate(this));
    SetUpLook();
    SetUpHeader();
    FitToFont();
    SetColumnWidths();
    FollowModel();
    ShowSortIndicator();
}

void SongListWidget::SetUpLook() {
    setSelectionBehavior(SelectRows);
    setSelectionMode(ExtendedSelection);
    setEditTriggers(NoEditTriggers);
    setAlternatingRowColors(true);
    setShowGrid(false);
    setWordWrap(false);
    setTabKeyNavigation(false);
    setHorizontalScrollMode(ScrollPerPixel);
}

void SongListWidget::SetUpHeader() {
    verticalHeader()->hide();
    verticalHeader()->setSectionResizeMode(QHeaderView::Fixed);
    QHeaderView* header = horizontalHeader();
    header->setHighlightSections(false);
    // A header that knew the selection would look through all rows for columns that are selected whole.
    header->setSelectionModel(new QItemSelectionModel(&model_, header));
    header->setSectionsMovable(true);
    header->setStretchLastSection(true);
    header->setSortIndicatorShown(true);
    header->setSectionsClickable(true);
    connect(header, &QHeaderView::sectionClicked, this, &SongListWidget::HeaderClicked);
}

// All rows have one height, which the header then need not keep for each.
void SongListWidget::FitToFont() {
    verticalHeader()->setMinimumSectionSize(0);
    verticalHeader()->setDefaultSectionSize(fontMetrics().height() + fontMetrics().height() / 3);
}

// A caption is never cut, whatever the font.
void SongListWidget::SetColumnWidths() {
    ensurePolished();
    for (int i = 0; i < model_.columnCount(); ++i) {
        const int wanted =
            SongColumns()[static_cast<std::size_t>(i)].Width * fontMetrics().averageCharWidth();
        setColumnWidth(i, std::max(wanted, horizontalHeader()->sectionSizeHint(i)));
    }
}

void SongListWidget::changeEvent(QEvent* event) {
    QTableView::changeEvent(event);
    if (event->type() == QEvent::FontChange || event->type() == QEvent::StyleChange) FitToFont();
}

// In a list of rows Home and End go to the first and the last row.
QModelIndex SongListWidget::moveCursor(CursorAction action, Qt::KeyboardModifiers modifiers) {
    if (model_.rowCount() == 0) return {};
    if (action == MoveHome) return model_.index(0, 0);
    if (action == MoveEnd) return model_.index(model_.rowCount() - 1, 0);
    return QTableView::moveCursor(action, modifiers);
}

// --- Order ---

void SongListWidget::SetOrder(const SongOrder& order) {
    {
        const WaitCursor wait;
        const QScopedValueRollback sorting(sorting_, true);
        model_.SetOrder(order);
    }
    ShowSortIndicator();
    if (!database_.FollowFocus() || !currentIndex().isValid()) return;
    executeDelayedItemsLayout();
    scrollTo(currentIndex(), PositionAtCenter);
}

void SongListWidget::SetSortingAllowed(bool allowed) {
    horizontalHeader()->setSectionsClickable(allowed);
}

void SongListWidget::HeaderClicked(int section) {
    const auto type = SongColumns()[static_cast<std::size_t>(section)].Sort;
    if (type) {
        SongOrder order = database_.Order();
        order.Backwards = order.SortType == *type && !order.Backwards;
        order.SortType = *type;
        RunCommand([&] { SetOrder(order); });
    }
    ShowSortIndicator();  // the header has moved it already, also to a column that has no order
}

void SongListWidget::ShowSortIndicator() {
    const SongOrder& order = database_.Order();
    horizontalHeader()->setSortIndicator(ColumnOfSortType(order.SortType),
                                         order.Backwards ? Qt::DescendingOrder : Qt::AscendingOrder);
}

// --- What stays when the list changes under the user's eyes ---

void SongListWidget::FollowModel() {
    connect(selectionModel(), &QItemSelectionModel::currentChanged, this, [this](const QModelIndex& current) {
        const TID3Tag* song = current.isValid() ? model_.SongAt(current.row()) : nullptr;
        if (song != nullptr) focusedPath_ = song->FileName;
        viewport()->update();  // the focus shows in whole rows, the view would paint single cells
    });
    connect(&model_, &QAbstractItemModel::layoutAboutToBeChanged, this, &SongListWidget::KeepTopRow);
    connect(&model_, &QAbstractItemModel::layoutChanged, this, &SongListWidget::RestoreTopRow);
    connect(&model_, &QAbstractItemModel::modelReset, this, &SongListWidget::RestoreFocus);
}

// Songs that come in above the visible ones do not push them out of sight; a list at its top stays there.
void SongListWidget::KeepTopRow() {
    topRow_ = QPersistentModelIndex();
    if (!sorting_ && verticalScrollBar()->value() > 0) topRow_ = indexAt(QPoint(0, 0));
}

void SongListWidget::RestoreTopRow() {
    if (!topRow_.isValid()) return;
    executeDelayedItemsLayout();
    verticalScrollBar()->setValue(topRow_.row());
    topRow_ = QPersistentModelIndex();
}

void SongListWidget::RestoreFocus() {
    ShowSortIndicator();
    const SongIndex index = focusedPath_.isEmpty() ? -1 : database_.IndexOf(focusedPath_);
    if (index < 0 || index >= model_.rowCount()) {
        focusedPath_.clear();
        return;
    }
    setCurrentIndex(model_.index(index, 0));
    if (!database_.FollowFocus()) return;
    executeDelayedItemsLayout();
    scrollTo(currentIndex(), PositionAtCenter);
}
