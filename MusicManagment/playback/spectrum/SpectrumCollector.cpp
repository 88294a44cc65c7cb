#include "MusicManagment/playback/spectrum/SpectrumCollector.h"

#include <chrono>

namespace {

constexpr std::chrono::milliseconds kStep{25};

}  // namespace

void SpectrumCollector::Start() {
    if (IsRunning()) return;
    thread_ = std::jthread([this](const std::stop_token& stop) { Run(stop); });
}

void SpectrumCollector::Stop() {
    thread_ = {};  // asks it to stop and waits
}

std::optional<SpectrumColumns> SpectrumCollector::Next(const std::stop_token& stop) {
    std::unique_lock lock(mutex_);
    if (!arrived_.wait(lock, stop, [this] { return news_.has_value(); })) return std::nullopt;
    return std::exchange(news_, std::nullopt);
}

void SpectrumCollector::Run(const std::stop_token& stop) {
    std::mutex resting;
    std::condition_variable_any rest;
    std::unique_lock lock(resting);
    auto next = std::chrono::steady_clock::now();
    while (!stop.stop_requested()) {
        Step();
        next = std::max(next + kStep, std::chrono::steady_clock::now());
        rest.wait_until(lock, stop, next, [] { return false; });
    }
}

void SpectrumCollector::Step() {
    const bool wasSilent = levels_.IsSilent();
    SpectrumBands bands;
    if (block_.Open() && block_.Read(bands))
        levels_.Take(bands);
    else
        levels_.Fall();
    if (wasSilent && levels_.IsSilent()) return;
    {
        const std::lock_guard lock(mutex_);
        news_ = levels_.Columns();
    }
    arrived_.notify_all();
}
