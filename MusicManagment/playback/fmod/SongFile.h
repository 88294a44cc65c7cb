#pragma once

#include <QString>
#include <memory>

#include "MusicManagment/playback/fmod/SoundSource.h"

// Loads a tracker or MIDI file, told by its contents and not by its name. Throws ESoundFileError when it is
// neither. `rate` in Hz; `midiFont` is a sound font, the system's when it is empty.
std::unique_ptr<SongSource> LoadSongFile(const QString& path, int rate, const QString& midiFont);
