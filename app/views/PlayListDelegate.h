#pragma once

#include "app/views/RowList.h"

// Paints the rows of a playlist: what waits in the queue has its place there behind the title.
class PlayListDelegate : public RowDelegate {
 public:
    using RowDelegate::RowDelegate;

    void paint(QPainter* painter, const QStyleOptionViewItem& option,
               const QModelIndex& index) const override;
};
