#pragma once

#include <QString>
#include <QStringList>

#include "MusicManagment/playback/eldos/SoundModule.h"

// Where modules are looked for, the first place in front: in the folder that TUNESTEAD_MODULES names, beside
// the program, and in ../lib/tunestead seen from there.
QStringList StandardModuleFolders();

// The module for a sound file, by the file's type. It stays loaded until the program ends. Throws
// EEldoSException when there is none for the type, or it cannot be loaded.
const EldoSModule& ModuleFor(const QString& fileName, const QStringList& folders);
