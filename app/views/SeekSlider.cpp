#include "app/views/SeekSlider.h"

#include <QKeyEvent>
#include <QMouseEvent>
#include <QStyle>
#include <QStyleOptionSlider>
#include <QToolTip>
#include <algorithm>

#include "ReadMPEGHeader/DisplayTexts.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kSecond = 1000;
constexpr int kStep = 5 * kSecond;
constexpr int kPage = 30 * kSecond;

}  // namespace

SeekSlider::SeekSlider(QWidget* parent) : QSlider(Qt::Horizontal, parent) {
    setObjectName(u"position"_s);
    setAccessibleName(u"Position"_s);
    setMouseTracking(true);
    setFocusPolicy(Qt::StrongFocus);
    setSingleStep(kStep);
    setPageStep(kPage);
    ShowPosition(0, 0);
}

void SeekSlider::ShowPosition(int position, int length) {
    setEnabled(length > 0);
    setMaximum(std::max(length, 1));
    if (!dragging_) setValue(position);
}

void SeekSlider::Seek(int position) {
    position = std::clamp(position, minimum(), maximum());
    setValue(position);
    if (OnSeek) OnSeek(position);
}

// --- Mouse ---

int SeekSlider::PositionAt(int x) const {
    QStyleOptionSlider option;
    initStyleOption(&option);
    const QRect groove = style()->subControlRect(QStyle::CC_Slider, &option, QStyle::SC_SliderGroove, this);
    const int handle =
        style()->subControlRect(QStyle::CC_Slider, &option, QStyle::SC_SliderHandle, this).width();
    return QStyle::sliderValueFromPosition(minimum(), maximum(), x - groove.x() - handle / 2,
                                           std::max(groove.width() - handle, 1), option.upsideDown);
}

void SeekSlider::mousePressEvent(QMouseEvent* event) {
    if (event->button() != Qt::LeftButton) return event->ignore();
    dragging_ = true;
    mouseMoveEvent(event);
}

void SeekSlider::mouseMoveEvent(QMouseEvent* event) {
    const int position = PositionAt(event->position().toPoint().x());
    if (dragging_) {
        setValue(position);
        if (OnDrag) OnDrag(position);
    } else if (isEnabled()) {
        QToolTip::showText(event->globalPosition().toPoint(), FormatLength(position / kSecond, true), this);
    }
    event->accept();
}

void SeekSlider::mouseReleaseEvent(QMouseEvent* event) {
    if (event->button() != Qt::LeftButton || !dragging_) return event->ignore();
    dragging_ = false;
    Seek(PositionAt(event->position().toPoint().x()));
}

// A window that is scrolled through must not move the song.
void SeekSlider::wheelEvent(QWheelEvent* event) {
    event->ignore();
}

// --- Keys ---

void SeekSlider::keyPressEvent(QKeyEvent* event) {
    const bool plain = (event->modifiers() & ~Qt::KeypadModifier) == 0;
    switch (plain ? event->key() : 0) {
        case Qt::Key_Left:
        case Qt::Key_Down:
            return Seek(value() - singleStep());
        case Qt::Key_Right:
        case Qt::Key_Up:
            return Seek(value() + singleStep());
        case Qt::Key_PageDown:
            return Seek(value() - pageStep());
        case Qt::Key_PageUp:
            return Seek(value() + pageStep());
        case Qt::Key_Home:
            return Seek(minimum());
        default:
            event->ignore();
    }
}
