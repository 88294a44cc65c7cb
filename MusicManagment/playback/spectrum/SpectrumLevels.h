#pragma once

#include <array>
#include <cstddef>

#include "MusicManagment/playback/spectrum/SpectrumBlock.h"

inline constexpr std::size_t kSpectrumColumns = 40;

// What is drawn of a spectrum: columns of equal musical width, from the lowest tone to the highest. Heights
// are 0 (60 dB below full level) to 1.
struct SpectrumColumns {
    std::array<float, kSpectrumColumns> Heights{};
    std::array<float, kSpectrumColumns> Peaks{};  // the highest of the last while

    bool operator==(const SpectrumColumns&) const = default;
};

// Makes columns of bands. They rise at once and fall slowly, so that the eye can follow.
class SpectrumLevels {
 public:
    // One step; 25 to 50 of them come in a second.
    void Take(const SpectrumBands& bands);
    // A step without news.
    void Fall();

    const SpectrumColumns& Columns() const { return columns_; }
    bool IsSilent() const { return columns_ == SpectrumColumns(); }

 private:
    SpectrumColumns columns_;
};
