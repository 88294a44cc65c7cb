#pragma once

#include <QColor>

#include "MusicManagment/playback/spectrum/SpectrumLevels.h"

class QPainter;
class QSizeF;

// How a spectrum is drawn. The numbers stand in the settings.
enum TSpectrumStyle : int { ssBars, ssLine, ssCircle };

struct SpectrumColors {
    QColor Background;
    QColor Columns;
    QColor Peaks;
};

// Fills an area of this size at the origin.
void PaintSpectrum(QPainter& painter, const QSizeF& size, const SpectrumColumns& columns,
                   TSpectrumStyle style, const SpectrumColors& colors);
