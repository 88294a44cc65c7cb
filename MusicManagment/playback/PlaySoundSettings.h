#pragma once

#include <QString>
#include <QtGlobal>

#include "MusicManagment/playback/fmod/FmodLibrary.h"

class TRWReg;

// Which engines the player may use, and how they are set.
struct EngineSettings {
    bool UseFMOD = true;
    bool UseMCI = true;
    bool UseEldoS = true;
    bool UseWinAmp = true;
    quint32 FMODCrossoverTime = 10000;  // ms; below kShortestFade nothing is faded
    TFSoundOutputTypes FMODSoundOutputTypes = FSOUND_OUTPUT_DSOUND;
    int FMODMixRate = 44100;  // Hz
    int FMODSoftChannels = 32;
    int FMODBufferSize = 0;
    QString WinAmpClassName = QStringLiteral("WinAmp v1.x");
    QString WinAmpFile = QStringLiteral("WinAmp.exe");
    int EldoSBufferCount = 4;
    int EldoSBufferSize = 32768;  // bytes

    bool operator==(const EngineSettings&) const = default;
};

inline constexpr quint32 kShortestFade = 3000;  // ms

// Values that are missing or out of range stay as they are.
void LoadEngineSettings(EngineSettings& engines, const TRWReg& settings);
void SaveEngineSettings(const EngineSettings& engines, TRWReg& settings);
