#pragma once

// What a sound file may claim: what is beyond is damage, and would keep a resampler busy for seconds.

inline constexpr int kLowestSoundRate = 1000;     // Hz
inline constexpr int kHighestSoundRate = 768000;  // Hz
inline constexpr int kMostSoundChannels = 32;

inline constexpr bool IsSoundFormat(int rate, int channels) {
    return rate >= kLowestSoundRate && rate <= kHighestSoundRate && channels >= 1 &&
           channels <= kMostSoundChannels;
}
