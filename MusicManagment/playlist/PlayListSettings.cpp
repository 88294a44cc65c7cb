#include "MusicManagment/playlist/PlayListSettings.h"

void TPlayList::LoadSettings(const TRWReg& settings) {
    LoadSettingsOf(*this, PlayListSettings::kAll, settings);
}

void TPlayList::SaveSettings(TRWReg& settings) const {
    SaveSettingsOf(*this, PlayListSettings::kAll, settings);
}

void TPlayList::UseRules(Rules rules) {
    SetRulesOf(*this, PlayListSettings::kRules, rules);
}
