#pragma once

#include <QString>

// The system's recycle bin.
class Trash {
 public:
    virtual ~Trash() = default;
    // Moves the file there; false when the system refuses, then the file is where it was.
    virtual bool Take(const QString& path) = 0;
};

// The bin in use; the system's own unless another was set. The caller keeps ownership; nullptr restores it.
Trash& CurrentTrash();
void SetTrash(Trash* trash);
