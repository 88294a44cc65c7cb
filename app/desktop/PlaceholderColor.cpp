#include "app/desktop/PlaceholderColor.h"

#include <QApplication>
#include <QPalette>
#include <cstdlib>

namespace {

constexpr int kLeastDifference = 80;  // of lightness, which goes to 255
constexpr int kPaleness = 140;        // alpha

}  // namespace

void KeepPlaceholdersLegible() {
    const QPalette palette = QApplication::palette();
    const int ground = palette.color(QPalette::Base).lightness();
    if (std::abs(palette.color(QPalette::PlaceholderText).lightness() - ground) >= kLeastDifference) return;
    QColor color = palette.color(QPalette::Text);
    color.setAlpha(kPaleness);
    QPalette mended;  // everything else stays the desktop's
    mended.setColor(QPalette::PlaceholderText, color);
    QApplication::setPalette(mended);
}
