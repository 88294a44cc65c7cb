#pragma once

#include <QIcon>
#include <QStyle>

// The program's own icon.
QIcon ProgramIcon();
// The icon of this name from the desktop's icon theme, or the style's own.
QIcon ThemeIcon(const QString& name, QStyle::StandardPixmap substitute);
// Where the desktop has chosen no icon theme, takes one that suits light or dark windows.
void ChooseIconTheme();
