#include "MusicManagment/playback/EngineChoice.h"

#include <array>

#include "MusicManagment/playback/backend/EngineErrors.h"
#include "MusicManagment/playback/backend/SoundTypes.h"

using namespace Qt::StringLiterals;

namespace {

struct EngineRow {
    TEngine Engine;
    QStringView Name;
    bool EngineSettings::*Allowed;
    bool (*Takes)(const SoundType&);
};

// In the order of preference, which is also the order of the fall-backs.
constexpr std::array<EngineRow, 4> kEngines = {{
    {TEngine::FMOD, u"FMOD", &EngineSettings::UseFMOD, [](const SoundType& type) { return type.FMOD; }},
    {TEngine::EldoS, u"EldoS", &EngineSettings::UseEldoS,
     [](const SoundType& type) { return !type.EldoSModule.isEmpty(); }},
    {TEngine::MCI, u"MCI", &EngineSettings::UseMCI, [](const SoundType& type) { return type.MCI; }},
    {TEngine::WinAmp, u"WinAmp", &EngineSettings::UseWinAmp, [](const SoundType&) { return true; }},
}};

const EngineRow& RowOf(TEngine engine) {
    return kEngines[static_cast<std::size_t>(engine)];
}

}  // namespace

QString EngineName(TEngine engine) {
    return RowOf(engine).Name.toString();
}

bool IsAllowed(TEngine engine, const EngineSettings& settings) {
    return settings.*RowOf(engine).Allowed;
}

std::optional<TEngine> ChooseEngine(const QString& fileName, const EngineSettings& settings) {
    const SoundType type = SoundTypeOf(fileName);
    for (const EngineRow& row : kEngines)
        if (row.Takes(type) && settings.*row.Allowed) return row.Engine;
    return std::nullopt;
}

std::vector<TEngine> EnginesAfter(TEngine failed, const EngineSettings& settings) {
    std::vector<TEngine> engines;
    for (const EngineRow& row : kEngines)
        if (row.Engine > failed && settings.*row.Allowed) engines.push_back(row.Engine);
    return engines;
}

std::unique_ptr<TPlaySoundContainer> EngineTable::Create(TEngine engine,
                                                         const EngineSettings& settings) const {
    const auto found = makers_.find(engine);
    if (found == makers_.end())
        throw EPlaySoundException(u"Die Engine %1 gibt es nicht."_s.arg(EngineName(engine)));
    return found->second(settings);
}
