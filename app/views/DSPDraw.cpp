#include "app/views/DSPDraw.h"

#include <QEvent>
#include <QPainter>
#include <utility>

using namespace Qt::StringLiterals;

TDSPDraw::TDSPDraw(const QString& key, QWidget* parent) : QWidget(parent), collector_(key) {
    SetUp();
}

TDSPDraw::TDSPDraw(QWidget* parent) : QWidget(parent) {
    SetUp();
}

TDSPDraw::~TDSPDraw() {
    OnDrawing = {};
    Stop();
}

void TDSPDraw::SetUp() {
    setObjectName(u"dspDraw"_s);
    setAccessibleName(u"Spektrum"_s);
    setAttribute(Qt::WA_OpaquePaintEvent);
}

QSize TDSPDraw::sizeHint() const {
    return {fontMetrics().averageCharWidth() * 40, fontMetrics().height() * 8};
}

QSize TDSPDraw::minimumSizeHint() const {
    return {fontMetrics().averageCharWidth() * 12, fontMetrics().height() * 3};
}

void TDSPDraw::SetStyle(TSpectrumStyle style) {
    style_ = style;
    DrawAgain();
}

// --- The threads ---

void TDSPDraw::Start() {
    if (IsDrawing()) return;
    TellCanvas();
    collector_.Start();
    drawing_ = std::jthread([this](const std::stop_token& stop) { Run(stop); });
    if (OnDrawing) OnDrawing(true);
}

void TDSPDraw::Stop() {
    if (!IsDrawing()) return;
    drawing_ = {};  // asks it to stop and waits
    collector_.Stop();
    if (OnDrawing) OnDrawing(false);
}

void TDSPDraw::Run(const std::stop_token& stop) {
    while (const auto columns = collector_.Next(stop))
        HandOver(Draw(*columns));
}

// However long the window is blocked, one picture waits for it, the latest.
void TDSPDraw::HandOver(QImage picture) {
    const std::lock_guard lock(mutex_);
    const bool told = next_.has_value();
    next_ = std::move(picture);
    if (!told) QMetaObject::invokeMethod(this, &TDSPDraw::ShowNext, Qt::QueuedConnection);
}

QImage TDSPDraw::Draw(const SpectrumColumns& columns) {
    Canvas canvas;
    {
        const std::lock_guard lock(mutex_);
        canvas = canvas_;
    }
    QImage picture(canvas.Size * canvas.Ratio, QImage::Format_RGB32);
    if (picture.isNull()) return picture;
    picture.setDevicePixelRatio(canvas.Ratio);
    QPainter painter(&picture);
    PaintSpectrum(painter, canvas.Size, columns, canvas.Style, canvas.Colors);
    return picture;
}

void TDSPDraw::ShowNext() {
    {
        const std::lock_guard lock(mutex_);
        if (!next_) return;
        picture_ = *std::exchange(next_, std::nullopt);
    }
    ++frames_;
    update();
}

// --- The widget ---

void TDSPDraw::TellCanvas() {
    const std::lock_guard lock(mutex_);
    canvas_.Size = size();
    canvas_.Ratio = devicePixelRatioF();
    canvas_.Style = style_;
    canvas_.Colors = Colors();
}

SpectrumColors TDSPDraw::Colors() const {
    return {palette().color(QPalette::Base), palette().color(QPalette::Highlight),
            palette().color(QPalette::Text)};
}

// In silence no picture comes, so an empty one is drawn here.
void TDSPDraw::DrawAgain() {
    TellCanvas();
    picture_ = QImage();
    update();
}

void TDSPDraw::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    if (picture_.isNull() || picture_.deviceIndependentSize().toSize() != size())
        PaintSpectrum(painter, size(), {}, style_, Colors());
    else
        painter.drawImage(0, 0, picture_);
}

void TDSPDraw::showEvent(QShowEvent* event) {
    QWidget::showEvent(event);
    Start();
}

void TDSPDraw::hideEvent(QHideEvent* event) {
    QWidget::hideEvent(event);
    Stop();
}

void TDSPDraw::resizeEvent(QResizeEvent* event) {
    QWidget::resizeEvent(event);
    DrawAgain();
}

void TDSPDraw::changeEvent(QEvent* event) {
    QWidget::changeEvent(event);
    if (event->type() == QEvent::PaletteChange || event->type() == QEvent::StyleChange) DrawAgain();
}
