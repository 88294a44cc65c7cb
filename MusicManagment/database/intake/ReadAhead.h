#pragma once

#include <QStringList>
#include <QThreadPool>
#include <deque>
#include <functional>
#include <future>
#include <optional>

#include "ReadMPEGHeader/SongReading.h"

// The files of a list, read by a few threads ahead of their turn, so that the waits for a slow disk overlap.
// They are handed out in the order of the list. Nothing here knows the collection, and all questions come
// back on the caller's thread.
class ReadAhead {
 public:
    // `isKnown` is asked some files ahead of a file's turn; one that is known is not read.
    ReadAhead(QStringList paths, std::function<bool(const QString& path)> isKnown);
    // Gives up what was not taken; waits only for the files that are being read.
    ~ReadAhead();
    ReadAhead(const ReadAhead&) = delete;
    ReadAhead& operator=(const ReadAhead&) = delete;

    // Moves to the next file, has the ones behind it read with `options`, and returns its path. Not at the
    // end of the list.
    const QString& Next(const ReadOptions& options);
    // The reading of that file, once. While it is not there yet `goOn` is called every few hundredths of a
    // second, to let the interface work; nothing when it returned false. Whatever a reading threw is its
    // error.
    std::optional<SongReading> Take(const ReadOptions& options, const std::function<bool()>& goOn);

 private:
    using Reading = std::future<SongReading>;

    Reading Begin(const QString& path, const ReadOptions& options);

    QStringList paths_;
    std::function<bool(const QString& path)> isKnown_;
    qsizetype current_ = -1;
    std::deque<Reading> ahead_;  // from the current file on; one that is not valid is not being read
    QThreadPool pool_;
};
