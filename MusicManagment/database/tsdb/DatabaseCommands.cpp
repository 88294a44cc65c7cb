#include <QScopeGuard>
#include <optional>

#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/tsdb/DatabaseFile.h"

// The commands that save and open a database.

using namespace Qt::StringLiterals;

namespace {

FileDialogOptions DialogOptions(const QString& title, const QString& preset) {
    FileDialogOptions options;
    options.Title = title;
    options.DefaultExtension = u"tsdb"_s;
    options.Filter = u"Tunestead DataBases|*.tsdb|Alle Dateien|*.*"_s;
    options.Preset = preset;
    return options;
}

std::optional<QString> AskForTarget(const QString& preset) {
    FileDialogOptions options = DialogOptions(u"Datenbank speichern unter"_s, preset);
    options.ConfirmOverwrite = true;
    return UserDialogs().SaveFile(options);
}

// The songs are what counts: what goes wrong beside them is told and holds up nothing.
void OpenSideFile(SideFile& side, const QString& database) {
    try {
        side.Open(SideFile::PathFor(database));
    } catch (const EStreamError& error) {
        UserDialogs().ShowMessage(MessageKind::Warning, error.Message());
    }
}

void SaveSideFile(SideFile& side, const QString& database, bool isCopy) {
    const QString path = SideFile::PathFor(database);
    try {
        if (isCopy)
            side.SaveCopy(path);
        else
            side.SaveAs(path);
    } catch (const EStreamError& error) {
        UserDialogs().ShowMessage(MessageKind::Warning, error.Message());
    }
}

FileSource OpenSource(const QString& fileName) {
    try {
        return FileSource(fileName);
    } catch (const EStreamError& error) {
        throw EMusicDatabaseException(u"Die Datenbank konnte nicht geöffnet werden\n"_s + error.Message());
    }
}

}  // namespace

bool TMusicDatabase::SaveDatabase(const QString& fileName, bool keepName, bool askForName) {
    RefuseDuringRun(*this);
    std::optional<QString> target = fileName.isEmpty() ? fileName_ : fileName;
    if (askForName || target->isEmpty()) target = AskForTarget(*target);
    if (!target || target->isEmpty()) return false;

    std::unique_ptr<FileLock> lock = fileLock_.ForSaving(*target);
    const bool wasModified = modified_;
    try {
        SafeFile file(*target);
        if (!WriteDatabase(*this, file)) return false;
        file.Commit();
    } catch (const EStreamError& error) {
        SetModified(wasModified);  // the songs were written, but not to where they will be looked for
        throw EMusicDatabaseException(error.Message());
    }
    if (!keepName) {
        fileName_ = *target;
        fileLock_.Adopt(std::move(lock));
    }
    SaveSideFile(side_, *target, *target != fileName_);
    return true;
}

bool TMusicDatabase::OpenDatabase(const QString& fileName, bool keepName) {
    RefuseReadingNow(*this);
    if (fileName.isEmpty()) {
        Clear(true, keepName);
        if (!keepName) fileLock_.Release();
        return true;
    }
    OpenSource(fileName);  // a file that cannot be read leaves everything as it is
    // Before reading: what somebody else saves in between would be missing.
    if (!keepName) fileLock_.Claim(fileName);
    FileSource source = OpenSource(fileName);
    // A part of the songs must not be saved over the file that holds them all, which the automatic save would
    // do; so the name comes last.
    if (!keepName) fileName_.clear();
    // Also of a database that could be read in part only: it may be saved over the old one.
    const auto openSideFile = qScopeGuard([&] { OpenSideFile(side_, fileName); });
    try {
        if (!ReadDatabase(*this, source)) return false;
    } catch (const EStreamError& error) {
        throw EMusicDatabaseException(error.Message());
    }
    if (!keepName) fileName_ = fileName;
    return true;
}

bool TMusicDatabase::OpenDatabaseFromDialog() {
    const auto chosen = UserDialogs().OpenFile(DialogOptions(u"Datenbank öffnen"_s, fileName_));
    return chosen && !chosen->isEmpty() && OpenDatabase(*chosen);
}
