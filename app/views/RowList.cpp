#include "app/views/RowList.h"

#include <QHeaderView>
#include <QTableView>

void RowDelegate::initStyleOption(QStyleOptionViewItem* option, const QModelIndex& index) const {
    QStyledItemDelegate::initStyleOption(option, index);
    option->state &= ~QStyle::State_HasFocus;
    const auto* view = qobject_cast<const QAbstractItemView*>(option->widget);
    if (view == nullptr || !view->hasFocus() || (option->state & QStyle::State_Selected) != 0) return;
    if (view->currentIndex().row() == index.row()) option->state |= QStyle::State_HasFocus;
}

void SetUpRowList(QTableView& view) {
    view.setSelectionBehavior(QTableView::SelectRows);
    view.setSelectionMode(QTableView::ExtendedSelection);
    view.setEditTriggers(QTableView::NoEditTriggers);
    view.setAlternatingRowColors(true);
    view.setShowGrid(false);
    view.setWordWrap(false);
    view.setTabKeyNavigation(false);
    view.setHorizontalScrollMode(QTableView::ScrollPerPixel);
    view.verticalHeader()->hide();
    view.verticalHeader()->setSectionResizeMode(QHeaderView::Fixed);
    view.horizontalHeader()->setHighlightSections(false);
    FitRowsToFont(view);
}

void FitRowsToFont(QTableView& view) {
    const int line = view.fontMetrics().height();
    view.verticalHeader()->setMinimumSectionSize(0);
    view.verticalHeader()->setDefaultSectionSize(line + line / 3);
}
