#pragma once

#include <QThreadPool>
#include <chrono>
#include <deque>
#include <functional>
#include <future>
#include <memory>
#include <optional>
#include <utility>

// For files that are read: that waits for the disk far more than it computes, so this does not follow the
// number of cores.
inline constexpr int kReadingThreads = 4;

// Pieces of work with the numbers 0, 1, 2, ..., done by a few threads ahead of their turn and handed out in
// their order. All questions come back on the caller's thread.
template <typename Result>
class WorkAhead {
 public:
    using Work = std::function<Result()>;
    enum class When { Ahead, OnItsTurn };
    // The work with this number; empty for one that is not to be done, of which the last word is asked when
    // it is taken. It runs in another thread.
    using Maker = std::function<Work(std::size_t number, When when)>;

    // `window`: so many pieces are begun at most, among them the current one.
    WorkAhead(std::size_t count, int threads, Maker maker, std::size_t window = 64)
        : count_(count), maker_(std::move(maker)), window_(window) {
        pool_.setMaxThreadCount(threads);
    }
    // Gives up what was not taken; waits only for what is being done.
    ~WorkAhead() {
        pool_.clear();
        pool_.waitForDone();
    }
    WorkAhead(const WorkAhead&) = delete;
    WorkAhead& operator=(const WorkAhead&) = delete;

    // Moves to the next number, which must be below the count, and has those behind it begun.
    void Next() {
        if (current_) ahead_.pop_front();
        current_ = current_ ? *current_ + 1 : 0;
        while (ahead_.size() < window_ && *current_ + ahead_.size() < count_)
            ahead_.push_back(Begin(*current_ + ahead_.size(), When::Ahead));
    }

    // The result of that number, once. While it is not there yet `goOn` is called every few hundredths of a
    // second, to let the interface work; nothing when it returned false, or when there is nothing to do.
    // Throws what the work threw.
    std::optional<Result> Take(const std::function<bool()>& goOn) {
        if (!ahead_.front().valid()) ahead_.front() = Begin(*current_, When::OnItsTurn);
        if (!ahead_.front().valid()) return std::nullopt;
        while (ahead_.front().wait_for(kPatience) != std::future_status::ready)
            if (!goOn()) return std::nullopt;
        return ahead_.front().get();
    }

 private:
    static constexpr std::chrono::milliseconds kPatience{30};

    std::future<Result> Begin(std::size_t number, When when) {
        Work work = maker_(number, when);
        if (!work) return {};
        const auto task = std::make_shared<std::packaged_task<Result()>>(std::move(work));
        pool_.start([task] { (*task)(); });
        return task->get_future();
    }

    std::size_t count_;
    Maker maker_;
    std::size_t window_;
    std::optional<std::size_t> current_;
    std::deque<std::future<Result>>
        ahead_;  // from the current one on; not valid where nothing was to be done
    QThreadPool pool_;
};
