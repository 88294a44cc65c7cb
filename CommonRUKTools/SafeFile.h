#pragma once

#include <QString>

#include "CommonRUKTools/ByteReader.h"

// Writes a new version of a file beside the old one (target name + ".tmp", or another name where somebody has
// that one) and puts it in its place in one step. The old file stays untouched until Commit(); without
// Commit() the destructor removes the temporary file.
class SafeFile {
 public:
    // Makes the temporary file. A target that is a symbolic link is followed. Throws EStreamError, also for a
    // target that is a device, a pipe or the like: it would be replaced by a file.
    explicit SafeFile(const QString& target);
    ~SafeFile();
    SafeFile(const SafeFile&) = delete;
    SafeFile& operator=(const SafeFile&) = delete;

    // Throws EStreamError (disk full, medium gone).
    void Write(ByteSpan bytes);
    void Seek(qint64 position);

    // Flushes to the disk and renames over the target, also over a read-only one.
    // Throws EStreamError when flushing fails and, with the message that names both files, when renaming
    // does.
    void Commit();

 private:
    void Create();
    void Close();

    QString target_;
    QString temporary_;
    int file_ = -1;  // descriptor
    bool committed_ = false;
};
