#include "cli/BannListKeeper.h"

#include "CommonRUKTools/FileSource.h"
#include "MusicManagment/database/BannList.h"

BannListKeeper::BannListKeeper(TMusicDatabase& database, QString path, Console& console)
    : database_(database), path_(std::move(path)), console_(console) {
    if (path_.isEmpty()) return;
    if (FileSource::Exists(path_)) LoadBannList(database.BannList(), path_);
    changes_ = database.Events().BannListChanged.Subscribe([this] { Save(); });
}

// Within a step, which goes on.
void BannListKeeper::Save() {
    try {
        SaveBannList(database_.BannList(), path_);
        isKept_ = true;
    } catch (const EStreamError& error) {
        isKept_ = false;
        console_.Message(error.Message());
    }
}
