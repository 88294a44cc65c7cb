#pragma once

#include <QByteArray>
#include <QString>

// The address under which GStreamer plays a file. It knows no MIDI in a RIFF wrapper (.rmi): that is handed
// over without it, within the address. And a .cda file has no sound, it only names a track of the disc in the
// drive.
QByteArray MediaAddress(const QString& path);
