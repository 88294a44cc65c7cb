#pragma once

#include <QString>
#include <optional>
#include <vector>

#include "CommonRUKTools/FileWork.h"

// A file on its way to its name: it lies beside it under one that begins with ".tunestead-convert-" and ends
// in ".tmp", which nothing takes for a song, and is removed unless it gets the name.
class PartialFile {
 public:
    // Of a file with this name; nothing is made yet. Throws EStreamError where the folder cannot be made.
    explicit PartialFile(const QString& target);
    ~PartialFile();
    PartialFile(const PartialFile&) = delete;
    PartialFile& operator=(const PartialFile&) = delete;

    const QString& Path() const { return path_; }
    // Flushes it and gives it its name. Throws EStreamError, also where something has that name.
    void TakeName();

 private:
    QString target_;
    QString path_;
    bool hasName_ = false;
};

// A message in which the user's own name stands for those of files on their way to it.
QString NamedAsTarget(QString message, const QString& target);

// Removes what conversions that did not come to their end have left in the folder: what was not written for
// an hour.
void SweepPartialFiles(const QString& folder);

// Writes a new file through a buffer. All throw EStreamError (disk full, medium gone).
class FileWriter {
 public:
    explicit FileWriter(const QString& path) : file_(WorkFile::New(path)) {}

    void Append(ByteSpan bytes);
    void Overwrite(std::int64_t position, ByteSpan bytes);
    std::int64_t Size() const { return written_ + static_cast<std::int64_t>(buffer_.size()); }
    // What was appended is in the file afterwards.
    void Finish() { Empty(); }

 private:
    void Empty();

    WorkFile file_;
    std::vector<std::uint8_t> buffer_;
    std::int64_t written_ = 0;
};
