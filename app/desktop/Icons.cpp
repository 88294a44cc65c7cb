#include "app/desktop/Icons.h"

#include <QApplication>
#include <QPalette>

using namespace Qt::StringLiterals;

QIcon ProgramIcon() {
    return QIcon(u":/tunestead.svg"_s);
}

QIcon ThemeIcon(const QString& name, QStyle::StandardPixmap substitute) {
    return QIcon::hasThemeIcon(name) ? QIcon::fromTheme(name)
                                     : QApplication::style()->standardIcon(substitute);
}

void ChooseIconTheme() {
    const bool dark = QApplication::palette().color(QPalette::Window).lightness() < 128;
    const QString suitable = dark ? u"breeze-dark"_s : u"breeze"_s;
    // "hicolor" is what Qt takes when the desktop names none; it holds programs' icons only.
    if (QIcon::themeName().isEmpty() || QIcon::themeName() == u"hicolor"_s) QIcon::setThemeName(suitable);
    QIcon::setFallbackThemeName(suitable);
}
