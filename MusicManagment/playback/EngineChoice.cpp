#include "MusicManagment/playback/EngineChoice.h"

#include <algorithm>
#include <array>
#include <span>

#include "MusicManagment/playback/backend/EngineErrors.h"

using namespace Qt::StringLiterals;

namespace {

constexpr QStringView kFmodExtensions[] = {u".mp3", u".mp2", u".wma", u".wav", u".mid", u".rmi", u".raw",
                                           u".asf", u".ogg", u".mod", u".s3m", u".xm",  u".it",  u".sgt"};
constexpr QStringView kEldosExtensions[] = {u".mp3", u".mp2", u".wma", u".wav"};
constexpr QStringView kMciExtensions[] = {u".mp3", u".mp2", u".wma", u".wav",
                                          u".mid", u".rmi", u".cda", u".avi"};

struct EngineRow {
    TEngine Engine;
    QStringView Name;
    bool EngineSettings::*Allowed;
    std::span<const QStringView> Extensions;  // empty: any
};

// In the order of preference, which is also the order of the fall-backs.
constexpr std::array<EngineRow, 4> kEngines = {{
    {TEngine::FMOD, u"FMOD", &EngineSettings::UseFMOD, kFmodExtensions},
    {TEngine::EldoS, u"EldoS", &EngineSettings::UseEldoS, kEldosExtensions},
    {TEngine::MCI, u"MCI", &EngineSettings::UseMCI, kMciExtensions},
    {TEngine::WinAmp, u"WinAmp", &EngineSettings::UseWinAmp, {}},
}};

const EngineRow& RowOf(TEngine engine) {
    return kEngines[static_cast<std::size_t>(engine)];
}

// With its dot, in lower case; empty for a name without one.
QString ExtensionOf(const QString& fileName) {
    const qsizetype dot = fileName.lastIndexOf(u'.');
    return dot > fileName.lastIndexOf(u'/') ? fileName.mid(dot).toLower() : QString();
}

}  // namespace

QString EngineName(TEngine engine) {
    return RowOf(engine).Name.toString();
}

bool IsAllowed(TEngine engine, const EngineSettings& settings) {
    return settings.*RowOf(engine).Allowed;
}

std::optional<TEngine> ChooseEngine(const QString& fileName, const EngineSettings& settings) {
    const QString extension = ExtensionOf(fileName);
    for (const EngineRow& row : kEngines) {
        const bool takes = row.Extensions.empty() ||
                           std::ranges::find(row.Extensions, QStringView(extension)) != row.Extensions.end();
        if (takes && settings.*row.Allowed) return row.Engine;
    }
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
