#include "app/dialogs/TableLook.h"

#include <QHeaderView>
#include <QTableWidget>

namespace {

// Rows as high as the font asks for, also when it changes.
constexpr double kRowHeight = 1.5;  // lines

}  // namespace

void SetTableLook(QTableWidget& table, const QStringList& headings, int shownRows) {
    table.setHorizontalHeaderLabels(headings);
    table.verticalHeader()->hide();
    table.verticalHeader()->setSectionResizeMode(QHeaderView::ResizeToContents);
    table.horizontalHeader()->setSectionResizeMode(QHeaderView::ResizeToContents);
    table.horizontalHeader()->setStretchLastSection(true);
    table.horizontalHeader()->setDefaultAlignment(Qt::AlignLeft | Qt::AlignVCenter);
    table.horizontalHeader()->setHighlightSections(false);
    table.setSelectionMode(QAbstractItemView::SingleSelection);
    table.setEditTriggers(QAbstractItemView::DoubleClicked | QAbstractItemView::EditKeyPressed |
                          QAbstractItemView::AnyKeyPressed);
    table.setTabKeyNavigation(false);
    table.setWordWrap(false);
    const double lines = (shownRows + 1) * kRowHeight;
    table.setMinimumHeight(static_cast<int>(lines * table.fontMetrics().lineSpacing()));
}
