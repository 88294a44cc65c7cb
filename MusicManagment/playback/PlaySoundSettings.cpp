#include "MusicManagment/playback/PlaySoundSettings.h"

#include "CommonRUKTools/RWReg.h"

using namespace Qt::StringLiterals;

namespace {

struct BoolRow {
    QStringView Name;
    bool EngineSettings::*Value;
};

constexpr BoolRow kBools[] = {
    {u"UseFMOD", &EngineSettings::UseFMOD},
    {u"UseMCI", &EngineSettings::UseMCI},
    {u"UseEldoS", &EngineSettings::UseEldoS},
    {u"UseWinamp", &EngineSettings::UseWinAmp},
};

struct NumberRow {
    QStringView Name;
    int EngineSettings::*Value;
    int Least;
    int Most;
};

constexpr NumberRow kNumbers[] = {
    {u"FMODMixRate", &EngineSettings::FMODMixRate, 4000, 192000},
    {u"FMODSoftChannels", &EngineSettings::FMODSoftChannels, 1, 1024},
    {u"FMODBufferSize", &EngineSettings::FMODBufferSize, 0, 10000},
    {u"EldoSBufferCount", &EngineSettings::EldoSBufferCount, 1, 64},
    {u"EldoSBufferSize", &EngineSettings::EldoSBufferSize, 1024, 1 << 22},
};

struct TextRow {
    QStringView Name;
    QString EngineSettings::*Value;
};

constexpr TextRow kTexts[] = {
    {u"WinAmpClassName", &EngineSettings::WinAmpClassName},
    {u"WinAmpFileName", &EngineSettings::WinAmpFile},
};

}  // namespace

void LoadEngineSettings(EngineSettings& engines, const TRWReg& settings) {
    for (const BoolRow& row : kBools)
        engines.*row.Value = settings.ReadBool(row.Name.toString()).value_or(engines.*row.Value);
    for (const NumberRow& row : kNumbers) {
        const auto value = settings.ReadInteger(row.Name.toString());
        if (value && *value >= row.Least && *value <= row.Most) engines.*row.Value = *value;
    }
    for (const TextRow& row : kTexts)
        engines.*row.Value = settings.ReadString(row.Name.toString()).value_or(engines.*row.Value);
    if (const auto time = settings.ReadInteger(u"CrossoverTime"_s); time && *time >= 0)
        engines.FMODCrossoverTime = static_cast<quint32>(*time);
    const auto output = settings.ReadInteger(u"FMODSoundOutput"_s);
    if (output && *output >= FSOUND_OUTPUT_NOSOUND && *output <= FSOUND_OUTPUT_XBOX)
        engines.FMODSoundOutputTypes = static_cast<TFSoundOutputTypes>(*output);
}

void SaveEngineSettings(const EngineSettings& engines, TRWReg& settings) {
    for (const BoolRow& row : kBools)
        settings.WriteBool(row.Name.toString(), engines.*row.Value);
    for (const NumberRow& row : kNumbers)
        settings.WriteInteger(row.Name.toString(), engines.*row.Value);
    for (const TextRow& row : kTexts)
        settings.WriteString(row.Name.toString(), engines.*row.Value);
    settings.WriteInteger(u"CrossoverTime"_s, static_cast<int>(engines.FMODCrossoverTime));
    settings.WriteInteger(u"FMODSoundOutput"_s, engines.FMODSoundOutputTypes);
}
