#include "CommonRUKTools/Trash.h"

#include "CommonRUKTools/platform/SystemTrash.h"

namespace {

Trash*& Installed() {
    static Trash* trash = nullptr;
    return trash;
}

}  // namespace

bool Trash::Take(const QString& path) {
    const QString place = PlaceFor(path);
    return !place.isEmpty() && TakeTo(path, place);
}

QString Trash::PlaceFor(const QString&) {
    return {};
}

bool Trash::TakeTo(const QString&, const QString&) {
    return false;
}

bool Trash::Restore(const QString&, const QString&) {
    return false;
}

Trash& CurrentTrash() {
    return Installed() != nullptr ? *Installed() : SystemTrash();
}

void SetTrash(Trash* trash) {
    Installed() = trash;
}
