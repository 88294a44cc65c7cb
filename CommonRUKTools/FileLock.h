#pragma once

#include <QString>
#include <cstdint>

// Keeps other programs that ask for it from writing a file at the same time. It is a lock of the system's
// kernel, so it goes with the program that holds it, however that ends. It lies on a small file beside the
// other (".NAME.lock"), because a file that is saved is a new one each time.
class FileLock {
 public:
    // Takes the lock of `path`, which need not exist yet. Where no lock can be had, because the folder is not
    // to be written or the file system has none, it counts as taken: nobody else gets one either.
    explicit FileLock(const QString& path);
    ~FileLock();
    FileLock(const FileLock&) = delete;
    FileLock& operator=(const FileLock&) = delete;

    // False while another program has it, or another object of this one.
    bool IsTaken() const { return holder_.isEmpty(); }
    // Who has it, for a message: "tunestead (Prozess 4711)", with the computer where that is another one.
    const QString& Holder() const { return holder_; }
    // Whether it is the lock of this file, under whatever path.
    bool IsOf(const QString& path) const;

 private:
    QString lockFile_;
    QString holder_;
    std::intptr_t handle_ = -1;
};
