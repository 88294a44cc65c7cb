#pragma once

#include <QTimer>
#include <functional>

#include "MusicManagment/playback/spectrum/SpectrumBlock.h"

// Where a spectrum comes from. All of it is called in the thread of the feed.
struct SpectrumSource {
    // Whether it is to be computed at all.
    std::function<void(bool active)> SetActive;
    // The amplitudes of kSpectrumBands bands, good until the next call; nullptr for none.
    std::function<const float*()> Get;
};

// The player's side of the block: asks the sound library for the spectrum some forty times a second and
// writes it down, as long as somebody wants to see it.
class SpectrumFeed {
 public:
    explicit SpectrumFeed(SpectrumSource source);
    SpectrumFeed(SpectrumSource source, const QString& key);
    ~SpectrumFeed();

    void Start();
    void Stop();
    // Starts whenever somebody looks, be it in another program, and stops when nobody does any more: Look()
    // twice a second.
    void Watch();
    void Look();
    // One look at the source.
    void Step();

 private:
    void SetUp();

    SpectrumSource source_;
    SpectrumBlock block_;
    QTimer timer_;
    QTimer watchTimer_;
    std::uint32_t looks_ = 0;  // at the last Look
};
