#pragma once

#include "CommonRUKTools/SettingsSchema.h"
#include "MusicManagment/database/SongTypes.h"
#include "app/views/SpectrumPainter.h"

// What the windows and their views keep in the settings: their values and what these may be.
namespace WindowSettings {

// A form placement: what Qt makes of the position and size of a window, or of the state of its docks.
inline constexpr Setting<QByteArray> kMainForm{u"MainForm"};
inline constexpr Setting<QByteArray> kMainFormState{u"MainFormState"};
inline constexpr Setting<QByteArray> kDuplicatesForm{u"DuplicatesForm"};
inline constexpr Setting<QByteArray> kSongListColumns{u"SongListColumns"};
// The flag that the song list shows as a mark; 0: the names of all flags.
inline constexpr Setting<int> kSongListFlag{u"SongListFlag", 0, 0, sfRemixed};
// By which tags were read from the names of files last; empty: that of the files' names.
inline constexpr Setting<QString> kTagsFromNamesPattern{u"TagsFromNamesPattern"};
// The file by which artists and titles were corrected last.
inline constexpr Setting<QString> kCorrectionFile{u"CorrectionFile"};
// That songs are opened with; empty: the desktop's program for them.
inline constexpr Setting<QString> kExternalProgram{u"ExternalProgram"};
// Where converted songs go: beside their sources, into the folder, in their place.
inline constexpr Setting<int> kConversionPlace{u"ConversionPlace", 0, 0, 2};
inline constexpr Setting<QString> kConversionFolder{u"ConversionFolder"};
inline constexpr Setting<QString> kLinkPath{u"LinkPath"};
// Absent counts as true.
inline constexpr Setting<bool> kFirstTime{u"FirstTime", true};

inline constexpr Setting<int> kOVType{u"OVType", ovArtist, ovArtist, kOverviewTypeCount - 1};
// What a double click in the song list plays: false is also what follows there.
inline constexpr Setting<bool> kPlayOnlyThisSong{u"PlayOnlyThisSong"};
inline constexpr Setting<int> kVolume{u"Volume", 100, 0, 100};  // per cent
inline constexpr Setting<int> kSpectrumStyle{u"SpectrumStyle", ssBars, ssBars, ssCircle};

}  // namespace WindowSettings
