#include "app/views/SpectrumPainter.h"

#include <QPainter>
#include <QPolygonF>
#include <cmath>
#include <numbers>

namespace {

constexpr int kCount = static_cast<int>(kSpectrumColumns);

double HeightOf(const SpectrumColumns& columns, int column) {
    return static_cast<double>(columns.Heights[static_cast<std::size_t>(column)]);
}

double PeakOf(const SpectrumColumns& columns, int column) {
    return static_cast<double>(columns.Peaks[static_cast<std::size_t>(column)]);
}

void PaintBars(QPainter& painter, const QSizeF& size, const SpectrumColumns& columns,
               const SpectrumColors& colors) {
    const double step = size.width() / kCount;
    const double width = std::max(step * 0.75, 1.0);
    for (int i = 0; i < kCount; ++i) {
        const double left = i * step + (step - width) / 2;
        const double height = HeightOf(columns, i) * size.height();
        painter.fillRect(QRectF(left, size.height() - height, width, height), colors.Columns);
        const double peak = PeakOf(columns, i) * (size.height() - 2);
        if (peak > 0) painter.fillRect(QRectF(left, size.height() - peak - 2, width, 2), colors.Peaks);
    }
}

// Three parts of the one and one of the other.
QColor Mixed(const QColor& most, const QColor& some) {
    const auto mix = [](int one, int other) { return (3 * one + other) / 4; };
    return {mix(most.red(), some.red()), mix(most.green(), some.green()), mix(most.blue(), some.blue())};
}

void PaintLine(QPainter& painter, const QSizeF& size, const SpectrumColumns& columns,
               const SpectrumColors& colors) {
    const double step = size.width() / (kCount - 1);
    QPolygonF line;
    for (int i = 0; i < kCount; ++i)
        line << QPointF(i * step, size.height() * (1 - HeightOf(columns, i)));
    QPolygonF area = line;
    area << QPointF(size.width(), size.height()) << QPointF(0, size.height());
    // Opaque and with steps at its edge, which the line covers: smooth and translucent it takes thrice the
    // time.
    painter.setRenderHint(QPainter::Antialiasing, false);
    painter.setPen(Qt::NoPen);
    painter.setBrush(Mixed(colors.Background, colors.Columns));
    painter.drawPolygon(area);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.setPen(QPen(colors.Columns, 2));
    painter.drawPolyline(line);
}

// Rays from a ring, the low tones on top, both sides alike.
void PaintCircle(QPainter& painter, const QSizeF& size, const SpectrumColumns& columns,
                 const SpectrumColors& colors) {
    const QPointF centre(size.width() / 2, size.height() / 2);
    const double outer = std::min(size.width(), size.height()) / 2 - 2;
    const double inner = outer * 0.35;
    if (outer <= 0) return;
    const auto at = [&](double angle, double radius) {
        return centre + QPointF(std::sin(angle), -std::cos(angle)) * radius;
    };
    const double thickness = std::max(inner * std::numbers::pi / kCount * 0.7, 1.0);
    for (int i = 0; i < kCount; ++i) {
        const double angle = (i + 0.5) * std::numbers::pi / kCount;
        const double end = inner + HeightOf(columns, i) * (outer - inner);
        const double peak = inner + PeakOf(columns, i) * (outer - inner);
        for (const double side : {angle, -angle}) {
            painter.setPen(QPen(colors.Columns, thickness, Qt::SolidLine, Qt::FlatCap));
            painter.drawLine(at(side, inner), at(side, std::max(end, inner + 1)));
            painter.setPen(QPen(colors.Peaks, thickness, Qt::SolidLine, Qt::FlatCap));
            if (peak > end + 1) painter.drawLine(at(side, peak - 1), at(side, peak + 1));
        }
    }
}

}  // namespace

void PaintSpectrum(QPainter& painter, const QSizeF& size, const SpectrumColumns& columns,
                   TSpectrumStyle style, const SpectrumColors& colors) {
    painter.fillRect(QRectF(QPointF(), size), colors.Background);
    if (style == ssBars) return PaintBars(painter, size, columns, colors);
    painter.setRenderHint(QPainter::Antialiasing);
    if (style == ssLine) return PaintLine(painter, size, columns, colors);
    PaintCircle(painter, size, columns, colors);
}
