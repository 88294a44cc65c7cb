#pragma once

#include "MusicManagment/playback/PlaySound.h"
#include "MusicManagment/playback/PlaySoundSettings.h"

// The settings of the player besides those of its engines (PlaySoundSettings.h), and the properties that hold
// them.
namespace PlayerSettings {

inline constexpr PropertySetting kAutoPlay{Setting<bool>{u"PSAutoPlay"}, &TPlaySound::AutoPlay,
                                           &TPlaySound::SetAutoPlay};
inline constexpr PropertySetting kPlayExtern{Setting<bool>{u"PSPlayExtern"}, &TPlaySound::PlayExtern,
                                             &TPlaySound::SetPlayExtern};
inline constexpr PropertySetting kTimerInterval{Setting<int>{u"PSTimerInterval", 250, 1, 10'000},  // ms
                                                &TPlaySound::TimerInterval, &TPlaySound::SetTimerInterval};

inline constexpr std::tuple kOwn{kAutoPlay, kPlayExtern, kTimerInterval};

}  // namespace PlayerSettings
