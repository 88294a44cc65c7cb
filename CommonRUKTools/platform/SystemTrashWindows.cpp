#include <QFile>

#include "CommonRUKTools/platform/SystemTrash.h"

namespace {

// The shell has no place that is known before.
class ShellTrash : public Trash {
 public:
    bool Take(const QString& path) override { return QFile::moveToTrash(path); }
};

}  // namespace

Trash& SystemTrash() {
    static ShellTrash trash;
    return trash;
}
