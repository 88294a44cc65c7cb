#include "app/desktop/InstallationSteps.h"

#include <QFileInfo>
#include <algorithm>

#include "CommonRUKTools/Dialogs.h"
#include "CommonRUKTools/Errors.h"
#include "CommonRUKTools/Trash.h"
#include "app/desktop/Installation.h"

using namespace Qt::StringLiterals;

namespace {

bool AnyExists(const QStringList& files) {
    return std::ranges::any_of(files, [](const QString& file) { return QFileInfo::exists(file); });
}

void ThrowAway(const QStringList& files) {
    for (const QString& file : files)
        if (QFileInfo::exists(file) && !CurrentTrash().Take(file))
            throw EStreamError(u"Kann die Datei "_s + file + u" nicht in den Papierkorb verschieben."_s);
}

void Tell(const QString& text, const QStringList& complaints) {
    if (complaints.isEmpty()) return UserDialogs().ShowMessage(MessageKind::Information, text);
    UserDialogs().ShowMessage(MessageKind::Warning,
                              text + u"\n\nNicht gelungen ist:\n"_s + complaints.join(u'\n'));
}

}  // namespace

void InstallationSteps::Install(const QString& linkFolder) {
    if (!IsPossible()) return;
    const QStringList complaints = installation_->Install(linkFolder);
    Tell(u"Tunestead steht jetzt im Menü Ihres Systems, und seine Dateitypen sind angemeldet."_s, complaints);
}

void InstallationSteps::Refresh() {
    if (installation_ == nullptr) return;
    const QStringList complaints = installation_->Refresh();
    if (!complaints.isEmpty()) Tell(u"Die Dateitypen von Tunestead sind erneuert."_s, complaints);
}

void InstallationSteps::Uninstall(const QString& linkFolder) {
    if (!IsPossible()) return;
    const RemovalChoice choice = AskWhatGoes();
    if (!choice.Program) return;
    const QStringList complaints = installation_->Remove(linkFolder);
    removed_.Program = true;
    if (choice.Database) ThrowAway({files_.Database()});
    removed_.Database = choice.Database;
    if (choice.Lists) ThrowAway({files_.BannList(), files_.PlayList()});
    removed_.Lists = choice.Lists;
    if (choice.Settings) ThrowAway({settingsFile_});
    removed_.Settings = choice.Settings;
    Tell(
        u"Tunestead ist aus dem Menü und von den Dateitypen Ihres Systems abgemeldet und wird jetzt beendet."_s,
        complaints);
}

// All questions come before anything is removed.
RemovalChoice InstallationSteps::AskWhatGoes() const {
    RemovalChoice choice;
    choice.Program = UserDialogs().AskYesNo(
        u"Soll Tunestead aus dem Menü und von den Dateitypen Ihres Systems entfernt werden? Ihre Songs "
        u"bleiben, "
        "wo sie sind."_s);
    if (!choice.Program) return choice;
    choice.Database = UserDialogs().AskYesNo(u"Soll die Datenbank ebenfalls entfernt werden?"_s);
    if (AnyExists({files_.BannList(), files_.PlayList()}))
        choice.Lists = UserDialogs().AskYesNo(u"Sollen Bann-Liste und PlayList ebenfalls entfernt werden?"_s);
    choice.Settings = UserDialogs().AskYesNo(u"Sollen die Einstellungen ebenfalls entfernt werden?"_s);
    return choice;
}

bool InstallationSteps::IsPossible() const {
    if (installation_ == nullptr)
        UserDialogs().ShowMessage(
            MessageKind::Information,
            u"Auf diesem System kann sich Tunestead noch nicht selbst einrichten oder entfernen."_s);
    return installation_ != nullptr;
}
