#include "MusicManagment/database/DatabaseLock.h"

#include <QDir>

#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/database/MusicManagment.h"

using namespace Qt::StringLiterals;

namespace {

QString HolderText(const QString& path, const FileLock& lock) {
    return u"Die Datenbank "_s + QDir::toNativeSeparators(path) + u" ist in "_s + lock.Holder() +
           u" geöffnet"_s;
}

}  // namespace

void DatabaseLock::Claim(const QString& path) {
    if (!wanted_ || (lock_ && lock_->IsTaken() && lock_->IsOf(path))) return;
    Release();  // first, for the file may be the same one, which somebody else had and has no more
    Adopt(std::make_unique<FileLock>(path));
    if (!IsElsewhere()) return;
    wasReadOnly_ = database_.ReadOnly();
    database_.SetReadOnly(true);
    UserDialogs().ShowMessage(MessageKind::Warning,
                              HolderText(path, *lock_) + u" und kann hier nur gelesen werden."_s);
}

void DatabaseLock::Release() {
    if (IsElsewhere()) database_.SetReadOnly(wasReadOnly_);
    lock_.reset();
}

std::unique_ptr<FileLock> DatabaseLock::ForSaving(const QString& path) const {
    if (!wanted_) return nullptr;
    const bool isOwn = lock_ && lock_->IsOf(path);
    if (isOwn && lock_->IsTaken()) return nullptr;
    if (isOwn)
        throw EMusicDatabaseException(HolderText(path, *lock_) + u" und kann hier nur gelesen werden."_s);
    auto lock = std::make_unique<FileLock>(path);
    if (!lock->IsTaken())
        throw EMusicDatabaseException(HolderText(path, *lock) + u" und kann jetzt nicht ersetzt werden."_s);
    return lock;
}

void DatabaseLock::Adopt(std::unique_ptr<FileLock> lock) {
    if (!lock) return;
    Release();
    lock_ = std::move(lock);
}
