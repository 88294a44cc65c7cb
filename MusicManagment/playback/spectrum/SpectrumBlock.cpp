#include "MusicManagment/playback/spectrum/SpectrumBlock.h"

#include <QStandardPaths>
#include <atomic>

using namespace Qt::StringLiterals;

// Fresh memory is all zeros, which is a block that nobody has written to. The counter is odd while somebody
// writes.
struct SpectrumBlock::Contents {
    std::atomic<std::uint32_t> Counter;
    std::atomic<std::uint32_t> Looks;
    std::array<std::atomic<float>, kSpectrumBands> Bands;
};

static_assert(std::atomic<std::uint32_t>::is_always_lock_free && std::atomic<float>::is_always_lock_free,
              "atomics with a lock mean nothing in another process");

SpectrumBlock::SpectrumBlock(const QString& key) : memory_(key) {}

QString SpectrumBlock::UserKey() {
    return u"RUK DSP "_s + QStandardPaths::writableLocation(QStandardPaths::HomeLocation);
}

// A block of another size is none of ours.
bool SpectrumBlock::Open() {
    if (IsOpen()) return true;
    constexpr auto kSize = static_cast<qsizetype>(sizeof(Contents));
    if (!memory_.create(kSize) && !memory_.attach()) return false;
    if (memory_.size() >= kSize) return true;
    memory_.detach();
    return false;
}

SpectrumBlock::Contents* SpectrumBlock::Shared() {
    return IsOpen() ? static_cast<Contents*>(memory_.data()) : nullptr;
}

void SpectrumBlock::Write(const SpectrumBands& bands) {
    Contents* shared = Shared();
    if (shared == nullptr) return;
    // Also after a writer that ended in the middle the counter becomes odd now.
    const std::uint32_t writing = shared->Counter.load(std::memory_order_relaxed) | 1U;
    shared->Counter.store(writing, std::memory_order_relaxed);
    std::atomic_thread_fence(std::memory_order_release);
    for (std::size_t i = 0; i < kSpectrumBands; ++i)
        shared->Bands[i].store(bands[i], std::memory_order_relaxed);
    shared->Counter.store(writing + 1, std::memory_order_release);
}

bool SpectrumBlock::Read(SpectrumBands& bands) {
    Contents* shared = Shared();
    if (shared == nullptr) return false;
    shared->Looks.fetch_add(1, std::memory_order_relaxed);
    const std::uint32_t before = shared->Counter.load(std::memory_order_acquire);
    if (before == seen_ || (before & 1U) != 0) return false;
    for (std::size_t i = 0; i < kSpectrumBands; ++i)
        bands[i] = shared->Bands[i].load(std::memory_order_relaxed);
    std::atomic_thread_fence(std::memory_order_acquire);
    if (shared->Counter.load(std::memory_order_relaxed) != before) return false;
    seen_ = before;
    return true;
}

std::uint32_t SpectrumBlock::Looks() {
    const Contents* shared = Shared();
    return shared != nullptr ? shared->Looks.load(std::memory_order_relaxed) : 0;
}
