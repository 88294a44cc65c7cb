#pragma once

#include <array>
#include <cstddef>
#include <memory>

// The amplitudes of the bands of a short piece of sound, by a Fourier transform of it under a Hann window. A
// sine reads its own amplitude in its band.
class Spectrum {
 public:
    static constexpr std::size_t kFrames = 1024;
    static constexpr std::size_t kBands = kFrames / 2;

    Spectrum();
    ~Spectrum();

    // kBands values, good until the next call.
    const float* Of(const std::array<float, kFrames>& mono);
    const float* Silence();

 private:
    struct Plan;
    std::unique_ptr<Plan> plan_;
    std::array<float, kFrames> window_{};
    std::array<float, kBands> bands_{};
};
