#include "MusicManagment/playback/spectrum/SpectrumFeed.h"

#include <algorithm>

SpectrumFeed::SpectrumFeed(SpectrumSource source) : source_(std::move(source)) {
    SetUp();
}

SpectrumFeed::SpectrumFeed(SpectrumSource source, const QString& key)
    : source_(std::move(source)), block_(key) {
    SetUp();
}

SpectrumFeed::~SpectrumFeed() {
    Stop();
}

void SpectrumFeed::SetUp() {
    constexpr int kStep = 25;  // milliseconds
    timer_.setInterval(kStep);
    timer_.setTimerType(Qt::PreciseTimer);
    timer_.callOnTimeout([this] { Step(); });
    watchTimer_.callOnTimeout([this] { Look(); });
}

void SpectrumFeed::Start() {
    if (timer_.isActive()) return;
    source_.SetActive(true);
    timer_.start();
}

void SpectrumFeed::Stop() {
    if (!timer_.isActive()) return;
    timer_.stop();
    source_.SetActive(false);
    block_.Write({});  // whoever still looks sees silence
}

void SpectrumFeed::Watch() {
    constexpr int kInterval = 500;  // milliseconds
    watchTimer_.start(kInterval);
}

void SpectrumFeed::Look() {
    if (!block_.Open()) return;
    const std::uint32_t looks = block_.Looks();
    looks != looks_ ? Start() : Stop();
    looks_ = looks;
}

// The block is asked for each time: two that make it at once may both fail at first.
void SpectrumFeed::Step() {
    if (!block_.Open()) return;
    const float* amplitudes = source_.Get();
    if (amplitudes == nullptr) return;
    SpectrumBands bands;
    std::copy_n(amplitudes, bands.size(), bands.begin());
    block_.Write(bands);
}
