#pragma once

#include <QIcon>

// The icon of a command by its name in the freedesktop icon themes; none for an empty name.
QIcon MenuIcon(QStringView name);
