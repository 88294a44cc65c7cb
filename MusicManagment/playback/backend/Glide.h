#pragma once

#include <cstddef>

// How long a sound takes into silence when it is cut, and a gain to another one: short enough to be heard as
// at once, long enough not to be heard as a click.
inline constexpr int kGlideMs = 20;

// `rate` in Hz; at least one frame.
inline constexpr std::size_t GlideFrames(int rate) {
    return static_cast<std::size_t>(rate) * kGlideMs / 1000 + 1;
}

// A gain that goes to another one in a straight line, frame by frame.
class Glide {
 public:
    explicit Glide(float gain = 1) : now_(gain), target_(gain) {}

    float Now() const { return now_; }
    bool Rests() const { return left_ == 0; }
    void Jump(float gain) {
        now_ = target_ = gain;
        left_ = 0;
    }
    // Within so many frames. One that is on its way there already goes on as it does.
    void To(float gain, std::size_t frames) {
        if (gain == target_) return;
        target_ = gain;
        left_ = frames;
        step_ = frames > 0 ? (gain - now_) / static_cast<float>(frames) : 0;
        if (frames == 0) now_ = gain;
    }
    // The gain of the next frame.
    float Next() {
        if (left_ == 0) return now_;
        --left_;
        now_ = left_ == 0 ? target_ : now_ + step_;
        return now_;
    }

 private:
    float now_;
    float target_;
    float step_ = 0;
    std::size_t left_ = 0;  // frames
};
