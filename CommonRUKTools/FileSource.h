#pragma once

#include <QString>
#include <cstdint>
#include <memory>
#include <span>
#include <vector>

#include "CommonRUKTools/ByteReader.h"

// Read access at any position of bytes that lie in a file or in memory. Not safe for use by two threads at
// once.
class ByteSource {
 public:
    virtual ~ByteSource() = default;
    virtual std::int64_t Size() const = 0;
    // Reads up to `target.size()` bytes from `position`; returns how many there were (fewer only at the end).
    // Throws EMediumError when the medium fails.
    virtual std::size_t ReadAt(std::int64_t position, std::span<std::uint8_t> target) = 0;

    // Exactly `count` bytes from `position`; the count is checked against the size before anything is
    // allocated. Throws EStreamError when there are fewer.
    std::vector<std::uint8_t> ReadExactly(std::int64_t position, std::size_t count);
};

class MemorySource : public ByteSource {
 public:
    explicit MemorySource(ByteSpan bytes) : bytes_(bytes) {}
    std::int64_t Size() const override { return static_cast<std::int64_t>(bytes_.size()); }
    std::size_t ReadAt(std::int64_t position, std::span<std::uint8_t> target) override;

 private:
    ByteSpan bytes_;
};

// A regular file opened for reading, without a buffer of its own: every read is one system call, so callers
// read in large pieces. On Windows the file is shared with readers and denied to writers; other systems have
// no such lock.
class FileSource : public ByteSource {
 public:
    // Throws EStreamError when the file cannot be opened or is not a regular file (a pipe never blocks here).
    explicit FileSource(const QString& path);
    // The same in one step with the question whether there is such a file: nullptr when the name leads to
    // nothing.
    static std::unique_ptr<FileSource> TryOpen(const QString& path);
    ~FileSource() override;
    FileSource(const FileSource&) = delete;
    FileSource& operator=(const FileSource&) = delete;

    // Says before opening whether the name leads to anything; a name that cannot be looked up does not.
    static bool Exists(const QString& path);

    std::int64_t Size() const override { return size_; }
    std::size_t ReadAt(std::int64_t position, std::span<std::uint8_t> target) override;

 private:
    // Takes an opened handle over, and closes it when it turns out not to be a regular file's.
    FileSource(std::intptr_t handle, const QString& path);

    std::intptr_t handle_ = -1;
    std::int64_t size_ = 0;
    QString path_;
};
