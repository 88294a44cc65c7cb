#pragma once

#include <QString>
#include <QtGlobal>

#include "CommonRUKTools/SettingsSchema.h"
#include "MusicManagment/playback/ExternalPlayer.h"
#include "MusicManagment/playback/PlayerPanel.h"
#include "MusicManagment/playback/backend/SoundOutputTypes.h"

// The settings of the player: which there are and what they may be.
namespace PlayerSettings {

// In a new installation no other program is started, and the light engine rests, until the user wants them.
inline constexpr Setting<bool> kUseFMOD{u"UseFMOD", true};
inline constexpr Setting<bool> kUseMCI{u"UseMCI", true};
inline constexpr Setting<bool> kUseEldoS{u"UseEldoS", true, false};
inline constexpr Setting<bool> kUseWinAmp{u"UseWinamp", true, false};
inline constexpr Setting<int> kCrossoverTime{u"CrossoverTime", 10'000, 0, kLongestTime};  // ms
inline constexpr Setting<int> kSoundOutput{u"FMODSoundOutput", FSOUND_OUTPUT_DSOUND, FSOUND_OUTPUT_NOSOUND,
                                           FSOUND_OUTPUT_XBOX};
inline constexpr Setting<int> kMixRate{u"FMODMixRate", 44'100, 4000, 192'000};  // Hz
inline constexpr Setting<int> kSoftChannels{u"FMODSoftChannels", 32, 1, 1024};
inline constexpr Setting<int> kBufferSize{u"FMODBufferSize", 0, 0, 10'000};  // ms; 0: the library's choice
inline constexpr Setting<QString> kWinAmpClassName{u"WinAmpClassName", u"WinAmp v1.x"};
inline constexpr Setting<QString> kWinAmpFile{u"WinAmpFileName", u"WinAmp.exe"};
inline constexpr Setting<int> kEldoSBufferCount{u"EldoSBufferCount", 4, 1, 64};
inline constexpr Setting<int> kEldoSBufferSize{u"EldoSBufferSize", 32'768, 1024, 4 << 20};  // bytes

// Kept by the panel.
inline constexpr Setting<int> kCrossover{u"Crossover", coAutoChange, coNone, coAlways};

}  // namespace PlayerSettings

// Which engines the player may use, and how they are set.
struct EngineSettings {
    bool UseFMOD = PlayerSettings::kUseFMOD.Default;
    bool UseMCI = PlayerSettings::kUseMCI.Default;
    bool UseEldoS = PlayerSettings::kUseEldoS.Default;
    bool UseWinAmp = PlayerSettings::kUseWinAmp.Default;
    // ms; below kShortestFade nothing is faded
    quint32 FMODCrossoverTime = PlayerSettings::kCrossoverTime.Default;
    TFSoundOutputTypes FMODSoundOutputTypes =
        static_cast<TFSoundOutputTypes>(PlayerSettings::kSoundOutput.Default);
    int FMODMixRate = PlayerSettings::kMixRate.Default;  // Hz
    int FMODSoftChannels = PlayerSettings::kSoftChannels.Default;
    int FMODBufferSize = PlayerSettings::kBufferSize.Default;
    QString WinAmpClassName = PlayerSettings::kWinAmpClassName.Default.toString();
    QString WinAmpFile = PlayerSettings::kWinAmpFile.Default.toString();
    int EldoSBufferCount = PlayerSettings::kEldoSBufferCount.Default;
    int EldoSBufferSize = PlayerSettings::kEldoSBufferSize.Default;  // bytes

    bool operator==(const EngineSettings&) const = default;
};

inline constexpr quint32 kShortestFade = 3000;  // ms

// A setting of the engines, and the command that carries it to a player program.
template <typename T, typename Value>
class EngineSetting : public MemberSetting<T, EngineSettings, Value> {
 public:
    constexpr EngineSetting(Setting<T> row, Value EngineSettings::*member, ExternalCommand command)
        : MemberSetting<T, EngineSettings, Value>(row, member), Command(command) {}

    ExternalCommand Command;
};

namespace PlayerSettings {

// In the order in which a new player program is told.
inline constexpr std::tuple kEngines{
    EngineSetting{kUseFMOD, &EngineSettings::UseFMOD, ecUseFMOD},
    EngineSetting{kUseMCI, &EngineSettings::UseMCI, ecUseMCI},
    EngineSetting{kUseEldoS, &EngineSettings::UseEldoS, ecUseEldoS},
    EngineSetting{kUseWinAmp, &EngineSettings::UseWinAmp, ecUseWinAmp},
    EngineSetting{kCrossoverTime, &EngineSettings::FMODCrossoverTime, ecCrossoverTime},
    EngineSetting{kSoundOutput, &EngineSettings::FMODSoundOutputTypes, ecSoundOutputTypes},
    EngineSetting{kMixRate, &EngineSettings::FMODMixRate, ecMixRate},
    EngineSetting{kSoftChannels, &EngineSettings::FMODSoftChannels, ecSoftChannels},
    EngineSetting{kBufferSize, &EngineSettings::FMODBufferSize, ecBufferSize},
    EngineSetting{kEldoSBufferCount, &EngineSettings::EldoSBufferCount, ecEldoSBufferCount},
    EngineSetting{kEldoSBufferSize, &EngineSettings::EldoSBufferSize, ecEldoSBufferSize},
    EngineSetting{kWinAmpClassName, &EngineSettings::WinAmpClassName, ecWinAmpClassName},
    EngineSetting{kWinAmpFile, &EngineSettings::WinAmpFile, ecWinAmpFile},
};

}  // namespace PlayerSettings

// Takes over what a command carries: a number, or a text where the setting is one. A value that the setting
// does not accept leaves it as it is. False when the command carries no setting.
bool TakeEngineSetting(EngineSettings& settings, int command, qint64 number, const QString& text);
