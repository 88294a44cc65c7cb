#pragma once

#include <QIcon>

// The icon of a command of the database menu; none for most.
QIcon MenuIcon(int id);
// The same for the menus of the playlist and the player.
QIcon PlayListIcon(int id);
QIcon PlayerIcon(int id);
