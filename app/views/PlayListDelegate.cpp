#include "app/views/PlayListDelegate.h"

#include <QApplication>
#include <QPainter>

#include "app/models/PlayListModel.h"

namespace {

// A pill with the number, at the end of the cell; returns how much of the cell it takes.
int PaintQueuePlace(QPainter& painter, const QStyleOptionViewItem& option, int place) {
    const QString text = QString::number(place);
    QFont font = option.font;
    font.setBold(true);
    const QFontMetrics metrics(font);
    const int height = std::min(metrics.height(), option.rect.height() - 2);
    const int width = std::max(metrics.horizontalAdvance(text) + height / 2, height);
    const int gap = metrics.averageCharWidth() / 2;
    const QRect pill(option.rect.right() - gap - width, option.rect.center().y() - height / 2, width, height);

    const bool selected = (option.state & QStyle::State_Selected) != 0;
    painter.save();
    painter.setRenderHint(QPainter::Antialiasing);
    painter.setPen(Qt::NoPen);
    painter.setBrush(option.palette.color(selected ? QPalette::HighlightedText : QPalette::Highlight));
    painter.drawRoundedRect(pill, height / 2.0, height / 2.0);
    painter.setPen(option.palette.color(selected ? QPalette::Highlight : QPalette::HighlightedText));
    painter.setFont(font);
    painter.drawText(pill, Qt::AlignCenter, text);
    painter.restore();
    return width + 2 * gap;
}

}  // namespace

void PlayListDelegate::paint(QPainter* painter, const QStyleOptionViewItem& option,
                             const QModelIndex& index) const {
    const int place = index.data(PlayListModel::QueueRole).toInt();
    if (place == 0 || index.column() != static_cast<int>(PlayListColumn::Title))
        return RowDelegate::paint(painter, option, index);

    QStyleOptionViewItem cell = option;
    initStyleOption(&cell, index);
    const QStyle* style = cell.widget != nullptr ? cell.widget->style() : QApplication::style();
    style->drawPrimitive(QStyle::PE_PanelItemViewItem, &cell, painter, cell.widget);
    cell.rect.setRight(cell.rect.right() - PaintQueuePlace(*painter, cell, place));
    RowDelegate::paint(painter, cell, index);
}
