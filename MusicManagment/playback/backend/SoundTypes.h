#pragma once

#include <QString>
#include <algorithm>

// Which engine plays which type of file; the one place where the extensions of sound files stand for playing.
struct SoundType {
    QStringView Extension;  // in lower case, without its dot
    bool FMOD = false;
    QStringView EldoSModule{};  // empty: EldoS does not play it
    bool MCI = false;
};

inline constexpr SoundType kSoundTypes[] = {
    {.Extension = u"mp3", .FMOD = true, .EldoSModule = u"ELAMP.ESP", .MCI = true},
    {.Extension = u"mp2", .FMOD = true, .EldoSModule = u"ELAMP.ESP", .MCI = true},
    {.Extension = u"wma", .FMOD = true, .EldoSModule = u"WMAMP.ESP", .MCI = true},
    {.Extension = u"wav", .FMOD = true, .EldoSModule = u"WAVMP.ESP", .MCI = true},
    {.Extension = u"mid", .FMOD = true, .MCI = true},
    {.Extension = u"rmi", .FMOD = true, .MCI = true},
    {.Extension = u"raw", .FMOD = true},
    {.Extension = u"asf", .FMOD = true},
    {.Extension = u"ogg", .FMOD = true},
    {.Extension = u"mod", .FMOD = true},
    {.Extension = u"s3m", .FMOD = true},
    {.Extension = u"xm", .FMOD = true},
    {.Extension = u"it", .FMOD = true},
    {.Extension = u"sgt", .FMOD = true},
    {.Extension = u"cda", .MCI = true},
    {.Extension = u"avi", .MCI = true},
};

// Of a file's name; a type that no engine but the last one plays when it is in no row.
inline SoundType SoundTypeOf(const QString& fileName) {
    const qsizetype dot = fileName.lastIndexOf(u'.');
    if (dot <= fileName.lastIndexOf(u'/')) return {};
    const QString extension = fileName.mid(dot + 1).toLower();
    const auto* found = std::ranges::find(kSoundTypes, QStringView(extension), &SoundType::Extension);
    return found != std::end(kSoundTypes) ? *found : SoundType{};
}
