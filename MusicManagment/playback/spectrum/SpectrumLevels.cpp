#include "MusicManagment/playback/spectrum/SpectrumLevels.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr float kFall = 0.045F;  // of the full height, a step
constexpr float kPeakFall = 0.012F;
constexpr float kLowest = -60.0F;  // dB

// Bands FIRST to NEXT - 1 make a column. The lowest tones have less than a band for a column, so the columns
// take at least one each.
using Edges = std::array<std::size_t, kSpectrumColumns + 1>;

Edges MakeEdges() {
    Edges edges{};
    edges[0] = 1;  // band 0 is no tone
    for (std::size_t i = 1; i <= kSpectrumColumns; ++i) {
        const double share = static_cast<double>(i) / kSpectrumColumns;
        const auto wanted = static_cast<std::size_t>(std::pow(double{kSpectrumBands}, share));
        edges[i] = std::max(wanted, edges[i - 1] + 1);
    }
    edges[kSpectrumColumns] = kSpectrumBands;
    return edges;
}

// Also for what no amplitude should be: negative, infinite, no number.
float Height(float amplitude) {
    if (!(amplitude > 0.0F)) return 0.0F;
    return std::clamp(1.0F - 20.0F * std::log10(amplitude) / kLowest, 0.0F, 1.0F);
}

}  // namespace

void SpectrumLevels::Take(const SpectrumBands& bands) {
    static const Edges edges = MakeEdges();
    Fall();
    for (std::size_t i = 0; i < kSpectrumColumns; ++i) {
        const auto first = bands.begin() + static_cast<std::ptrdiff_t>(edges[i]);
        const auto next = bands.begin() + static_cast<std::ptrdiff_t>(edges[i + 1]);
        float& height = columns_.Heights[i];
        for (auto band = first; band != next; ++band)
            height = std::max(height, Height(*band));
        columns_.Peaks[i] = std::max(columns_.Peaks[i], height);
    }
}

void SpectrumLevels::Fall() {
    for (float& height : columns_.Heights)
        height = std::max(height - kFall, 0.0F);
    for (std::size_t i = 0; i < kSpectrumColumns; ++i)
        columns_.Peaks[i] = std::max(columns_.Peaks[i] - kPeakFall, columns_.Heights[i]);
}
