#include "app/desktop/NewInstallation.h"

#include "CommonRUKTools/RWReg.h"
#include "HTTPRetrieval/OnlineSearch.h"
#include "MusicManagment/database/commands/DatabaseSettings.h"
#include "MusicManagment/playback/PlayerSettings.h"
#include "MusicManagment/playlist/PlayListSettings.h"

void BeginInstallation(TRWReg& settings) {
    if (!settings.IsEmpty()) return;
    StoreNewValues(DatabaseSettings::kAll, settings);
    StoreNewValues(PlayListSettings::kAll, settings);
    StoreNewValues(PlayerSettings::kEngines, settings);
    StoreNewValues(PlayerSettings::kOwn, settings);
    StoreNewValues(OnlineSettings::kAll, settings);
}
