#pragma once

#include <QString>

// The program's own recycle folder, in the root folder of each volume.
inline constexpr QStringView kOwnRecycleFolder = u"Tunestead Recycle-Bin";

// Moves a file to the system's recycle bin or, when that refuses, into the program's own recycle folder on
// the same volume. An empty path or one on a catalogued CD counts as done. When both fail the user is told,
// in words that depend on `banned`, and the result is false.
bool MoveToRecycleBin(const QString& path, bool banned);
