#include "app/views/SongDrag.h"

#include <QDrag>
#include <QLocale>
#include <QPainter>
#include <QToolTip>
#include <QWidget>

using namespace Qt::StringLiterals;

namespace {

QString CountText(std::size_t count) {
    const QString number = QLocale(QLocale::German).toString(static_cast<qulonglong>(count));
    return number + (count == 1 ? u" Song"_s : u" Songs"_s);
}

QPixmap Label(const QWidget& source, const QString& text) {
    const QFontMetrics metrics = source.fontMetrics();
    const QSize size(metrics.horizontalAdvance(text) + metrics.height(), metrics.height() * 3 / 2);
    QPixmap picture(size * source.devicePixelRatioF());
    picture.setDevicePixelRatio(source.devicePixelRatioF());
    picture.fill(QToolTip::palette().color(QPalette::ToolTipBase));
    QPainter painter(&picture);
    painter.setFont(source.font());
    painter.setPen(QToolTip::palette().color(QPalette::ToolTipText));
    const QRect area(QPoint(), size);
    painter.drawRect(area.adjusted(0, 0, -1, -1));
    painter.drawText(area, Qt::AlignCenter, text);
    return picture;
}

}  // namespace

void DragSongs(QWidget& source, std::unique_ptr<SongMimeData> songs, Qt::DropActions actions) {
    auto* drag = new QDrag(&source);  // deletes itself after the drop
    drag->setPixmap(Label(source, CountText(songs->Count())));
    drag->setHotSpot({-12, -12});
    drag->setMimeData(songs.release());
    drag->exec(actions, Qt::CopyAction);
}
