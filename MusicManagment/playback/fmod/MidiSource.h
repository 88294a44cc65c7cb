#pragma once

#include <QByteArray>
#include <QString>
#include <memory>

#include "MusicManagment/playback/fmod/SoundSource.h"

// A MIDI song, rendered with a sound font; the system's when `font` is empty. Since MIDI knows no orders,
// every 144 ms count as an order of one row. Throws ESoundFileError. `rate` in Hz.
std::unique_ptr<SongSource> LoadMidiSong(const QByteArray& file, int rate, const QString& font);
