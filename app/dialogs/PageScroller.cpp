#include "app/dialogs/PageScroller.h"

#include <QApplication>
#include <QEvent>
#include <QScrollBar>

namespace {

constexpr int kLeastLines = 6;

}  // namespace

PageScroller::PageScroller(QWidget* sheet, QWidget* parent) : QScrollArea(parent) {
    setWidgetResizable(true);
    setFrameShape(QFrame::NoFrame);
    setFocusPolicy(Qt::NoFocus);
    setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    setWidget(sheet);
    connect(qApp, &QApplication::focusChanged, this, [this](QWidget*, QWidget* field) { ShowField(field); });
}

// Fields that go with it still move the focus.
PageScroller::~PageScroller() {
    disconnect(qApp, nullptr, this, nullptr);
}

// A letter may lead to a field that is out of sight. What the mouse is on stays where it is.
void PageScroller::ShowField(QWidget* field) {
    if (QApplication::mouseButtons() == Qt::NoButton && widget()->isAncestorOf(field))
        ensureWidgetVisible(field);
}

int PageScroller::FrameWidth() const {
    return 2 * frameWidth() + verticalScrollBar()->sizeHint().width();
}

QSize PageScroller::sizeHint() const {
    const int width = widget()->sizeHint().width();
    const int height =
        widget()->hasHeightForWidth() ? widget()->heightForWidth(width) : widget()->sizeHint().height();
    return QSize(width + FrameWidth(), height + 2 * frameWidth()).expandedTo(minimumSizeHint());
}

QSize PageScroller::minimumSizeHint() const {
    return {widget()->minimumSizeHint().width() + FrameWidth(), kLeastLines * fontMetrics().lineSpacing()};
}

bool PageScroller::event(QEvent* event) {
    if (event->type() == QEvent::LayoutRequest) updateGeometry();
    return QScrollArea::event(event);
}
