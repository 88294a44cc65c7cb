#pragma once

#include <QStringList>
#include <functional>
#include <optional>

#include "CommonRUKTools/WorkAhead.h"
#include "ReadMPEGHeader/SongReading.h"

// The files of a list, read by a few threads ahead of their turn, so that the waits for a slow disk overlap.
// They are handed out in the order of the list. Nothing here knows the collection, and all questions come
// back on the caller's thread.
class ReadAhead {
 public:
    // `options` must live as long and may be changed before each Next(). `isKnown` is asked some files ahead
    // of a file's turn; one that is known is not read.
    ReadAhead(QStringList paths, const ReadOptions& options,
              std::function<bool(const QString& path)> isKnown);

    // Moves to the next file, has the ones behind it read, and returns its path. Not at the end of the list.
    const QString& Next();
    // The reading of that file, once. While it is not there yet `goOn` is called every few hundredths of a
    // second, to let the interface work; nothing when it returned false. Whatever a reading threw is its
    // error.
    std::optional<SongReading> Take(const std::function<bool()>& goOn);

 private:
    QStringList paths_;
    qsizetype current_ = -1;
    WorkAhead<SongReading> work_;
};
