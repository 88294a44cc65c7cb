#pragma once

#include <QIcon>

// The icon of a command of the database menu; none for most.
QIcon MenuIcon(int id);
