#pragma once

#include <QString>
#include <cstddef>
#include <limits>

// What is about to happen on the disk.
enum class DiskStep {
    Create,    // a new file
    Write,     // bytes into a file
    Resize,    // a file becomes longer or shorter
    Flush,     // to the disk
    Describe,  // times, owner and attributes of a file
    TakeName,  // a file that is complete gets the name of the one that it replaces, or its final one
    Move,      // a file gets another name
    Remove,    // a file
    Folder,    // one is made or removed
};

// Every step that changes the user's files or their journal asks here first, so that a test can let any of
// them fail and can end the process before any of them.
class WriteGate {
 public:
    virtual ~WriteGate() = default;
    // 0 lets it happen; otherwise it fails with this error number (errno).
    virtual int Before(DiskStep step, const QString& path) = 0;
    // Whether a flush waits for the disk. A process that ends loses nothing that the system has taken over,
    // so a test of that need not wait.
    virtual bool WaitsForDisk() const { return true; }
    // The most bytes that are written in one step. Longer writes become several.
    virtual std::size_t LongestWrite() const { return std::numeric_limits<std::size_t>::max(); }
};

// Open unless another was set. The caller keeps ownership; nullptr opens it again.
WriteGate& CurrentWriteGate();
void SetWriteGate(WriteGate* gate);
