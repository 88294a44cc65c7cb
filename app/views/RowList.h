#pragma once

#include <QStyledItemDelegate>

class QTableView;

// What lists of rows have in common.

// Rows are chosen whole, so no single cell shows the focus; a focused row that is not selected does.
class RowDelegate : public QStyledItemDelegate {
 public:
    using QStyledItemDelegate::QStyledItemDelegate;

 protected:
    void initStyleOption(QStyleOptionViewItem* option, const QModelIndex& index) const override;
};

// Makes a table a list of rows of one height, that of its font, of which any number can be selected.
void SetUpRowList(QTableView& view);
// For when the font has changed: all rows have its height, which the header then need not keep for each.
void FitRowsToFont(QTableView& view);
