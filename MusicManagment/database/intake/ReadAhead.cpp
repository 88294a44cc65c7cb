#include "MusicManagment/database/intake/ReadAhead.h"

#include <chrono>
#include <exception>
#include <memory>

using namespace Qt::StringLiterals;

namespace {

// Reading waits for the disk far more than it computes, so this does not follow the number of cores.
constexpr int kThreads = 4;
constexpr std::size_t kWindow = 64;  // files, among them the current one
constexpr std::chrono::milliseconds kPatience{30};

SongReading ResultOf(std::future<SongReading> reading, const QString& path) {
    try {
        return reading.get();
    } catch (const std::exception& error) {
        SongReading failed;
        failed.Error =
            u"Unerwarteter Fehler beim Lesen von "_s + path + u": "_s + QString::fromUtf8(error.what());
        return failed;
    }
}

}  // namespace

ReadAhead::ReadAhead(QStringList paths, std::function<bool(const QString& path)> isKnown)
    : paths_(std::move(paths)), isKnown_(std::move(isKnown)) {
    pool_.setMaxThreadCount(kThreads);
}

ReadAhead::~ReadAhead() {
    pool_.clear();
    pool_.waitForDone();
}

const QString& ReadAhead::Next(const ReadOptions& options) {
    ++current_;
    if (!ahead_.empty()) ahead_.pop_front();
    while (ahead_.size() < kWindow && current_ + std::ssize(ahead_) < paths_.size()) {
        const QString& path = paths_[current_ + std::ssize(ahead_)];
        ahead_.push_back(isKnown_(path) ? Reading() : Begin(path, options));
    }
    return paths_[current_];
}

std::optional<SongReading> ReadAhead::Take(const ReadOptions& options, const std::function<bool()>& goOn) {
    const QString& path = paths_[current_];
    // The song has left the collection since it was found there.
    if (!ahead_.front().valid()) ahead_.front() = Begin(path, options);
    while (ahead_.front().wait_for(kPatience) != std::future_status::ready)
        if (!goOn()) return std::nullopt;
    return ResultOf(std::move(ahead_.front()), path);
}

ReadAhead::Reading ReadAhead::Begin(const QString& path, const ReadOptions& options) {
    const auto task = std::make_shared<std::packaged_task<SongReading()>>(
        [path, options] { return ReadSong(path, options); });
    pool_.start([task] { (*task)(); });
    return task->get_future();
}
