#pragma once

#include <QString>

// Waits until the bytes of an open file (its descriptor) are on the disk; false when the system reports a
// failure.
bool FlushToDisk(int descriptor);

// Renames `from` to `to` in one step, replacing a file that is there (also a read-only one), and makes the
// change of the folder durable. False when the system refuses; then both files are as they were.
bool ReplaceFile(const QString& from, const QString& to);
