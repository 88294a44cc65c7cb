#pragma once

#include <QStringList>

// The outputs of the FMOD engine as the user knows them, in the order of their stored numbers.
QStringList SoundOutputNames();
