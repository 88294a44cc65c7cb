#pragma once

#include <condition_variable>
#include <mutex>
#include <optional>
#include <stop_token>
#include <thread>

#include "MusicManagment/playback/spectrum/SpectrumLevels.h"

// The thread that collects what the block tells and makes columns of it, for another thread that draws them.
class SpectrumCollector {
 public:
    // Reads from the block with this key.
    explicit SpectrumCollector(const QString& key) : block_(key) {}
    SpectrumCollector() = default;

    void Start();
    void Stop();
    bool IsRunning() const { return thread_.joinable(); }

    // Waits until there is something new to draw; nothing when it was asked to stop. Of what came in the
    // meantime only the latest is given. In silence nothing comes.
    std::optional<SpectrumColumns> Next(const std::stop_token& stop);

 private:
    void Run(const std::stop_token& stop);
    void Step();

    SpectrumBlock block_;
    SpectrumLevels levels_;
    std::mutex mutex_;
    std::condition_variable_any arrived_;
    std::optional<SpectrumColumns> news_;  // under the mutex
    std::jthread thread_;                  // ends before the rest goes
};
