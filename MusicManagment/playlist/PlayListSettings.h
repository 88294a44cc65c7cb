#pragma once

#include "CommonRUKTools/SettingsSchema.h"
#include "MusicManagment/playlist/PlayList.h"

// The settings of the playlist: which there are, what they may be, and the properties that hold them.
namespace PlayListSettings {

inline constexpr PropertySetting kPlayOrder{
    Setting<int>{u"PlayOrder", poDownwards, poDownwards, poStopAfterPlay}, &TPlayList::PlayOrder,
    &TPlayList::SetPlayOrder};
inline constexpr PropertySetting kScan{Setting<bool>{u"Scan"}, &TPlayList::Scan, &TPlayList::SetScan};
// Milliseconds; 0 is no limit.
inline constexpr PropertySetting kScanTime{Setting<int>{u"ScanTime", 10'000, 0, kLongestTime},
                                           &TPlayList::ScanTime, &TPlayList::SetScanTime};
inline constexpr PropertySetting kRepeatAll{Setting<bool>{u"RepeatAll"}, &TPlayList::RepeatAll,
                                            &TPlayList::SetRepeatAll};
inline constexpr PropertySetting kCopyMp3sBeforePlay{
    Setting<bool>{u"CopyMp3sBeforePlay"}, &TPlayList::CopyMp3sBeforePlay, &TPlayList::SetCopyMp3sBeforePlay};

// Pairs of rules, classic when false and modern when true (Rules.h).
inline constexpr PropertySetting kModernLists{Setting<bool>{u"ModernLists", false, true},
                                              &TPlayList::ModernLists, &TPlayList::SetModernLists};

inline constexpr std::tuple kRules{kModernLists};

// The time before the switch: the player is then told once.
inline constexpr std::tuple kOwn{kPlayOrder, kScanTime, kScan, kRepeatAll, kCopyMp3sBeforePlay};
inline constexpr auto kAll = std::tuple_cat(kOwn, kRules);

}  // namespace PlayListSettings
