#include "CommonRUKTools/PrivateFolder.h"

#include <QDir>

#include "CommonRUKTools/Errors.h"

using namespace Qt::StringLiterals;

QString PrivateTemporaryFolder(const QString& name) {
    constexpr int kMostUsers = 100;
    const QString first = QDir::temp().filePath(name);
    for (int number = 1; number <= kMostUsers; ++number) {
        QString folder = number == 1 ? first : first + u' ' + QString::number(number);
        if (MakePrivateFolder(folder)) return folder;
    }
    throw EStreamError(u"Kann den Ordner nicht anlegen: "_s + first);
}
