#include "MusicManagment/playback/eldos/ModuleFiles.h"

#include <QCoreApplication>
#include <QDir>
#include <QFileInfo>
#include <QLibrary>

#include "MusicManagment/playback/backend/EngineErrors.h"
#include "MusicManagment/playback/backend/SoundTypes.h"

using namespace Qt::StringLiterals;

namespace {

// Null when there is no such file, or it is not a module of this version.
const EldoSModule* Load(const QString& path) {
    if (!QFileInfo(path).isFile()) return nullptr;
    QLibrary library(path);
    library.setLoadHints(QLibrary::PreventUnloadHint);
    const auto function = reinterpret_cast<EldoSModuleFunction>(library.resolve(kEldoSModuleSymbol));
    if (function == nullptr) {
        qWarning("%s: %s", qUtf8Printable(path), qUtf8Printable(library.errorString()));
        return nullptr;
    }
    const EldoSModule* module = function();
    return module != nullptr && module->version == kEldoSModuleVersion ? module : nullptr;
}

}  // namespace

QStringList StandardModuleFolders() {
    QStringList folders;
    const QString chosen = qEnvironmentVariable("TUNESTEAD_MODULES");
    if (!chosen.isEmpty()) folders << chosen;
    const QString program = QCoreApplication::applicationDirPath();
    folders << program << QDir::cleanPath(program + u"/../lib/tunestead"_s);
    return folders;
}

const EldoSModule& ModuleFor(const QString& fileName, const QStringList& folders) {
    const QStringView name = SoundTypeOf(fileName).EldoSModule;
    if (!name.isEmpty()) {
        for (const QString& folder : folders) {
            if (const EldoSModule* module = Load(QDir(folder).absoluteFilePath(name.toString())))
                return *module;
        }
    }
    throw EEldoSException(u"Kann keine zur Datei "_s + fileName + u" passende EldoS-Sound-DLL finden."_s);
}
