#include "app/views/CoverView.h"

#include <QPainter>

using namespace Qt::StringLiterals;

namespace {

constexpr int kHeight = 10;  // lines of text

}  // namespace

CoverView::CoverView(QWidget* parent) : QWidget(parent) {
    setObjectName(u"cover"_s);
    setAccessibleName(u"Cover"_s);
    setSizePolicy(QSizePolicy::Ignored, QSizePolicy::Fixed);
    hide();
}

void CoverView::SetImage(const QImage& image) {
    image_ = image;
    setVisible(!image.isNull());
    update();
}

QSize CoverView::sizeHint() const {
    const int edge = kHeight * fontMetrics().height();
    return {edge, edge};
}

void CoverView::paintEvent(QPaintEvent*) {
    if (image_.isNull()) return;
    const int margin = fontMetrics().height() / 4;
    const QRect room = contentsRect().adjusted(margin, margin, -margin, -margin);
    QRect place(QPoint(), image_.size().scaled(room.size(), Qt::KeepAspectRatio));
    place.moveCenter(room.center());
    QPainter painter(this);
    painter.setRenderHint(QPainter::SmoothPixmapTransform);
    painter.drawImage(place, image_);
}
