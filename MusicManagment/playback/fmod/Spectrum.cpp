#include "MusicManagment/playback/fmod/Spectrum.h"

#include <fftw3.h>

#include <cmath>
#include <new>
#include <numbers>

struct Spectrum::Plan {
    Plan() {
        if (input == nullptr || output == nullptr) throw std::bad_alloc();
        plan = fftwf_plan_dft_r2c_1d(static_cast<int>(kFrames), input.get(), output.get(), FFTW_ESTIMATE);
        if (plan == nullptr) throw std::bad_alloc();
    }
    ~Plan() { fftwf_destroy_plan(plan); }
    Plan(const Plan&) = delete;
    Plan& operator=(const Plan&) = delete;

    struct Free {
        void operator()(void* memory) const { fftwf_free(memory); }
    };
    std::unique_ptr<float[], Free> input{fftwf_alloc_real(kFrames)};
    std::unique_ptr<fftwf_complex[], Free> output{fftwf_alloc_complex(kBands + 1)};
    fftwf_plan plan = nullptr;
};

Spectrum::Spectrum() : plan_(std::make_unique<Plan>()) {
    for (std::size_t i = 0; i < kFrames; ++i) {
        const double turn = 2 * std::numbers::pi * static_cast<double>(i) / static_cast<double>(kFrames);
        window_[i] = static_cast<float>(0.5 - 0.5 * std::cos(turn));
    }
}

Spectrum::~Spectrum() = default;

const float* Spectrum::Of(const std::array<float, kFrames>& mono) {
    for (std::size_t i = 0; i < kFrames; ++i)
        plan_->input[i] = mono[i] * window_[i];
    fftwf_execute(plan_->plan);
    // Half of a sine stands in its band, and the window lets half of that through.
    constexpr float kScale = 4.0F / static_cast<float>(kFrames);
    for (std::size_t i = 0; i < kBands; ++i)
        bands_[i] = kScale * std::hypot(plan_->output[i][0], plan_->output[i][1]);
    return bands_.data();
}

const float* Spectrum::Silence() {
    bands_.fill(0);
    return bands_.data();
}
