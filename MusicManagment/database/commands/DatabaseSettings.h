#pragma once

#include "CommonRUKTools/SettingsSchema.h"
#include "MusicManagment/database/MusicManagment.h"

// The settings of the database: which there are, what they may be, and the properties that hold them.
namespace DatabaseSettings {

// Milliseconds, or -1: after every command. 0: never.
inline constexpr PropertySetting kAutoSave{Setting<int>{u"AutoSave", 0, -1, kLongestTime, -1},
                                           &TMusicDatabase::AutoSave, &TMusicDatabase::SetAutoSave};
inline constexpr PropertySetting kCompression{Setting<int>{u"Compression", clFastest, clNone, clMax},
                                              &TMusicDatabase::Compression, &TMusicDatabase::SetCompression};
inline constexpr PropertySetting kAsynchronous{
    Setting<bool>{u"Asynchronous", true}, &TMusicDatabase::Asynchronous, &TMusicDatabase::SetAsynchronous};
inline constexpr PropertySetting kAutoDelBannedFiles{Setting<bool>{u"AutoDelBannedFiles"},
                                                     &TMusicDatabase::AutoDelBannedFiles,
                                                     &TMusicDatabase::SetAutoDelBannedFiles};
inline constexpr PropertySetting kSortType{
    Setting<int>{u"SortType", stGenre, stTitle, stAlbumOrder, stAlbumOrder}, &TMusicDatabase::SortType,
    &TMusicDatabase::SetSortType};
inline constexpr PropertySetting kSubSortType{Setting<int>{u"SubSortType", sstGATL, sstGATL, sstPath},
                                              &TMusicDatabase::SubSortType, &TMusicDatabase::SetSubSortType};
inline constexpr PropertySetting kSortBackwards{
    Setting<bool>{u"SortBackwards"}, &TMusicDatabase::SortBackwards, &TMusicDatabase::SetSortBackwards};
inline constexpr PropertySetting kMoveMP3sAfterGenreChange{Setting<bool>{u"MoveMP3sAfterGenreChange"},
                                                           &TMusicDatabase::MoveMP3sAfterGenreChange,
                                                           &TMusicDatabase::SetMoveMP3sAfterGenreChange};
inline constexpr PropertySetting kUseWinAmpForLenCheck{Setting<bool>{u"UseWinAmpForLenCheck"},
                                                       &TMusicDatabase::UseWinAmpForLenCheck,
                                                       &TMusicDatabase::SetUseWinAmpForLenCheck};
inline constexpr PropertySetting kFollowFocus{Setting<bool>{u"FollowFocus", true},
                                              &TMusicDatabase::FollowFocus, &TMusicDatabase::SetFollowFocus};
inline constexpr PropertySetting kRenameAndMoveMP3s{Setting<bool>{u"RenameAndMoveMP3s", true},
                                                    &TMusicDatabase::RenameAndMoveMP3s,
                                                    &TMusicDatabase::SetRenameAndMoveMP3s};
// Its default depends on the user's folders.
inline constexpr PropertySetting kMP3MoveRootDir{
    Setting<QString>{u"MP3MoveRootDir"}, &TMusicDatabase::MP3MoveRootDir, &TMusicDatabase::SetMP3MoveRootDir};
inline constexpr PropertySetting kMP3NamePattern{Setting<QString>{u"MP3NamePattern", u"%ARTIST% - %TITLE%"},
                                                 &TMusicDatabase::MP3NamePattern,
                                                 &TMusicDatabase::SetMP3NamePattern};

// Pairs of rules, classic when false and modern when true (Rules.h).
inline constexpr PropertySetting kModernTags{Setting<bool>{u"ModernTags", false, true},
                                             &TMusicDatabase::ModernTags, &TMusicDatabase::SetModernTags};
inline constexpr PropertySetting kKeepLostSongs{Setting<bool>{u"KeepLostSongs", false, true},
                                                &TMusicDatabase::KeepLostSongs,
                                                &TMusicDatabase::SetKeepLostSongs};

inline constexpr PropertySetting kDerivedGenres{Setting<bool>{u"DerivedGenres", false, true},
                                                &TMusicDatabase::DerivedGenres,
                                                &TMusicDatabase::SetDerivedGenres};

inline constexpr PropertySetting kRenameInPlace{Setting<bool>{u"RenameInPlace", false, true},
                                                &TMusicDatabase::RenameInPlace,
                                                &TMusicDatabase::SetRenameInPlace};

inline constexpr PropertySetting kQuietBatches{Setting<bool>{u"QuietBatches", false, true},
                                               &TMusicDatabase::QuietBatches,
                                               &TMusicDatabase::SetQuietBatches};

inline constexpr PropertySetting kUnlimitedSearch{Setting<bool>{u"UnlimitedSearch", false, true},
                                                  &TMusicDatabase::UnlimitedSearch,
                                                  &TMusicDatabase::SetUnlimitedSearch};

inline constexpr PropertySetting kModernMedia{Setting<bool>{u"ModernMedia", false, true},
                                              &TMusicDatabase::ModernMedia, &TMusicDatabase::SetModernMedia};

inline constexpr std::tuple kRules{kModernTags,   kKeepLostSongs,   kDerivedGenres, kRenameInPlace,
                                   kQuietBatches, kUnlimitedSearch, kModernMedia};

inline constexpr std::tuple kOwn{kAutoSave,
                                 kCompression,
                                 kAsynchronous,
                                 kAutoDelBannedFiles,
                                 kSortType,
                                 kSubSortType,
                                 kSortBackwards,
                                 kMoveMP3sAfterGenreChange,
                                 kUseWinAmpForLenCheck,
                                 kFollowFocus,
                                 kRenameAndMoveMP3s,
                                 kMP3MoveRootDir,
                                 kMP3NamePattern};
inline constexpr auto kAll = std::tuple_cat(kOwn, kRules);

// Of the format conversion. The records belong to the encoders.
inline constexpr MemberSetting kWav{Setting<QByteArray>{u"WAVEncoderSettings", kWavRecordSize},
                                    &ConversionSettings::Wav};
inline constexpr MemberSetting kMp3{Setting<QByteArray>{u"MP3EncoderSettings", kMp3RecordSize},
                                    &ConversionSettings::Mp3};
inline constexpr MemberSetting kWma{Setting<QByteArray>{u"WMAEncoderSettings", kWmaRecordSize},
                                    &ConversionSettings::Wma};
inline constexpr MemberSetting kLastMusicFormat{Setting<int>{u"LastMusicFormat", 0, 0, 255},
                                                &ConversionSettings::LastMusicFormat};
inline constexpr MemberSetting kWmaScript{Setting<QString>{u"WMAEncoderScript"},
                                          &ConversionSettings::WmaScript};
inline constexpr MemberSetting kWmaArguments{Setting<QString>{u"WMAEncoderArguments"},
                                             &ConversionSettings::WmaArguments};
inline constexpr std::tuple kConversion{kWav, kMp3, kWma, kLastMusicFormat, kWmaScript, kWmaArguments};

// Of the remote control: whether other programs may use it.
inline constexpr Setting<bool> kRCEnabled{u"RCEnabled", true};

// Numbered lists: these names with 0, 1, ... behind them.
inline constexpr QStringView kGenreFolder = u"MP3MoveSubDirs";
inline constexpr QStringView kCdName = u"CDName";
inline constexpr QStringView kCdSerial = u"CDSerialNr";

}  // namespace DatabaseSettings
