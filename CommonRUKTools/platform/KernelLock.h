#pragma once

#include <QByteArray>
#include <QString>
#include <cstdint>

// The system's side of FileLock.
namespace KernelLock {

enum class Outcome {
    Taken,
    Held,         // by somebody else
    Unavailable,  // the file cannot be made, or the file system knows no locks
};

// Makes the file where it is missing and locks it without waiting. `handle` is set only when it is taken; the
// lock ends with it.
Outcome Take(const QString& file, std::intptr_t& handle);
// What the file says now, whoever has it.
QByteArray Contents(const QString& file);
void SetContents(std::intptr_t handle, const QByteArray& contents);
// Gives the lock up and removes the file.
void Release(const QString& file, std::intptr_t handle);

}  // namespace KernelLock
