#pragma once

#include <QString>

// The interfaces of an MPRIS player as the bus describes them, in its own notation.
QString MprisInterfaces();
