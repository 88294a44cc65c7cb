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

// Rules; false is the classic one.
inline constexpr PropertySetting kKeepAlbums{Setting<bool>{u"KeepAlbums", false, true},
                                             &TPlaySound::KeepAlbums, &TPlaySound::SetKeepAlbums};
inline constexpr PropertySetting kQuietFailures{Setting<bool>{u"QuietFailures", false, true},
                                                &TPlaySound::QuietFailures, &TPlaySound::SetQuietFailures};

inline constexpr std::tuple kRules{kKeepAlbums, kQuietFailures};
inline constexpr auto kOwn = std::tuple_cat(std::tuple{kAutoPlay, kPlayExtern, kTimerInterval}, kRules);

}  // namespace PlayerSettings
