#include "app/desktop/BannListFile.h"

#include <QFileInfo>

#include "CommonRUKTools/Errors.h"
#include "MusicManagment/database/BannList.h"

using namespace Qt::StringLiterals;

void BannListFile::Load() {
    state_ = State::Unreadable;
    if (QFileInfo::exists(files_.BannList())) LoadBannList(list_, files_.BannList());
    state_ = State::Loaded;
}

void BannListFile::Save() {
    const bool isNeeded = list_.Count() > 0 || QFileInfo::exists(files_.BannList());
    if (state_ == State::Loaded && isNeeded) {
        files_.MakeFolder();
        SaveBannList(list_, files_.BannList());
    } else if (state_ == State::Unreadable && list_.Count() > 0) {
        throw EStreamError(
            u"Die Bann-Liste konnte beim Start nicht gelesen werden und wird deshalb nicht überschrieben: "_s +
            files_.BannList());
    }
}

void BannListFile::Forget() {
    list_.Clear();
    state_ = State::NotLoaded;
}
