#pragma once

#include <QString>

// Where the small player program listens: a socket that only its user can reach. Empty when there is no place
// for it.
QString PlayerChannelPath();
