#include "CommonRUKTools/Trash.h"

#include <QFile>

namespace {

class SystemTrash : public Trash {
 public:
    bool Take(const QString& path) override { return QFile::moveToTrash(path); }
};

Trash*& Installed() {
    static Trash* trash = nullptr;
    return trash;
}

}  // namespace

Trash& CurrentTrash() {
    static SystemTrash system;
    return Installed() != nullptr ? *Installed() : system;
}

void SetTrash(Trash* trash) {
    Installed() = trash;
}
