#pragma once

#include <QString>

#include "CommonRUKTools/ByteReader.h"

// What writing a file safely needs of the system. Files are known by their descriptors. Whoever returns false
// or -1 leaves the reason in errno.

// Makes a file that was not there, for writing only; -1 also when something has that name.
int CreateNewFile(const QString& path);
bool WriteAll(int descriptor, ByteSpan bytes);
bool SeekTo(int descriptor, qint64 position);
bool CloseFile(int descriptor);

// Waits until the bytes of the file are on the disk.
bool FlushToDisk(int descriptor);

// Renames `from` to `to` in one step, replacing a file that is there (also a read-only one), and makes the
// change of the folder durable. False when the system refuses; then both files are as they were.
bool ReplaceFile(const QString& from, const QString& to);
