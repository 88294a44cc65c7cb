#pragma once

#include <QString>

// Paths of songs on a medium that can be taken away: ':' + 8 hexadecimal digits of its volume serial number +
// ':' + the path on the medium, which begins with '\' and has it as its separator on every system.

inline bool IsCdPath(const QString& path) {
    return path.startsWith(u':');
}
// 0 (no medium) for digits that are none, and for an ordinary path.
quint32 SerialOfCdPath(const QString& path);
// "\Musik\a.mp3", as it stands.
QString PathOnMedium(const QString& cdPath);
// `path` is the system's, from the mount point on: "/Musik/a.mp3".
QString MakeCdPath(quint32 serial, const QString& path);
// Where the song lies when its medium is mounted there.
QString FileAt(const QString& mountPoint, const QString& cdPath);

// 8 digits, as paths and views show them.
QString SerialText(quint32 serial);
