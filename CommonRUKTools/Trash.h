#pragma once

#include <QString>

// The system's recycle bin.
class Trash {
 public:
    virtual ~Trash() = default;
    // Moves the file there; false when the system refuses, then the file is where it was.
    virtual bool Take(const QString& path);

    // --- For who wants the file back ---
    // Where the file would lie in the bin, under a name that nothing has there yet; empty when the bin does
    // not take it or does not tell.
    virtual QString PlaceFor(const QString& path);
    // Moves the file to a place that was told for it. False like Take.
    virtual bool TakeTo(const QString& path, const QString& place);
    // Brings a file back, and takes away what the bin knew of it, also where the file never came. False when
    // it is not there any more, or something has its old name.
    virtual bool Restore(const QString& place, const QString& path);
};

// The bin in use; the system's own unless another was set. The caller keeps ownership; nullptr restores it.
Trash& CurrentTrash();
void SetTrash(Trash* trash);
