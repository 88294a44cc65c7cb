#include "MusicManagment/playback/PlaySoundSettings.h"

#include <limits>

#include "MusicManagment/playback/PlayerSettings.h"

using namespace PlayerSettings;

void TPlaySound::UseRules(Rules rules) {
    SetRulesOf(*this, kRules, rules);
}

void TPlaySound::LoadSettings(const TRWReg& settings) {
    EngineSettings engines = settings_;
    LoadSettingsOf(engines, kEngines, settings);
    SetEngines(engines);
    LoadSettingsOf(*this, kOwn, settings);
    const auto mode = ReadSetting(settings, kCrossover);
    if (panel_ != nullptr && mode) panel_->SetCrossover(static_cast<TCrossover>(*mode));
}

void TPlaySound::SaveSettings(TRWReg& settings) const {
    SaveSettingsOf(settings_, kEngines, settings);
    SaveSettingsOf(*this, kOwn, settings);
    if (panel_ != nullptr) WriteSetting(settings, kCrossover, panel_->Crossover());
}

void TPlaySound::UseRules(Rules rules) {
    SetRulesOf(*this, kRules, rules);
}

// --- What a player program is told ---

namespace {

std::optional<int> Accepted(const Setting<int>& setting, qint64 number) {
    const bool fits = number >= std::numeric_limits<int>::min() && number <= std::numeric_limits<int>::max();
    return fits && setting.Accepts(static_cast<int>(number)) ? std::optional(static_cast<int>(number))
                                                             : std::nullopt;
}

void Take(EngineSettings& settings, const auto& setting, qint64 number, const QString& text) {
    using Row = decltype(setting.Row);
    if constexpr (std::is_same_v<Row, Setting<QString>>) {
        setting.SetOf(settings, text);
    } else if constexpr (std::is_same_v<Row, Setting<bool>>) {
        setting.SetOf(settings, number != 0);
    } else if (const auto value = Accepted(setting.Row, number)) {
        setting.SetOf(settings, *value);
    }
}

}  // namespace

bool TakeEngineSetting(EngineSettings& settings, int command, qint64 number, const QString& text) {
    bool known = false;
    ForEachSetting(kEngines, [&](const auto& setting) {
        if (setting.Command != command) return;
        known = true;
        Take(settings, setting, number, text);
    });
    return known;
}
