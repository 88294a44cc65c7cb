#include "CommonRUKTools/StandardFiles.h"

#include <QCoreApplication>
#include <QDir>
#include <QFileInfo>
#include <QStandardPaths>

#include "CommonRUKTools/Errors.h"

using namespace Qt::StringLiterals;

namespace {

QString UserFolder(QStandardPaths::StandardLocation location) {
    return QStandardPaths::writableLocation(location) + u"/tunestead"_s;
}

bool HoldsOne(const StandardFiles& files) {
    return QFileInfo::exists(files.Database()) || QFileInfo::exists(files.BannList()) ||
           QFileInfo::exists(files.PlayList());
}

}  // namespace

QString StandardFiles::Database() const {
    return Folder + u"/Tunestead3_Database.tsdb"_s;
}

QString StandardFiles::BannList() const {
    return Folder + u"/Tunestead3_BannList.str"_s;
}

QString StandardFiles::PlayList() const {
    return Folder + u"/Tunestead3_PlayList.rukpl"_s;
}

QString StandardFiles::Journal() const {
    return Folder + u"/Tunestead3_Journal.tsj"_s;
}

void StandardFiles::MakeFolder() const {
    if (!QDir().mkpath(Folder)) throw EStreamError(u"Kann den Ordner "_s + Folder + u" nicht anlegen."_s);
}

StandardFiles LocateStandardFiles(const QString& programFolder, const QString& dataFolder) {
    const StandardFiles beside{programFolder};
    return QFileInfo(programFolder).isWritable() && HoldsOne(beside) ? beside : StandardFiles{dataFolder};
}

StandardFiles LocateStandardFiles() {
    return LocateStandardFiles(QCoreApplication::applicationDirPath(),
                               UserFolder(QStandardPaths::GenericDataLocation));
}
