#include "app/CollectionCommands.h"

#include <QDir>

#include "CommonRUKTools/CommandDispatcher.h"
#include "CommonRUKTools/CommandRunner.h"
#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/database/Command.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/intake/Intake.h"
#include "MusicManagment/database/intake/MediumQuestion.h"

using namespace Qt::StringLiterals;

namespace {

// `save` tells whether the program may end. Where it fails, the user decides.
bool SavedOrGivenUp(const std::function<bool()>& save, const QString& loss) {
    try {
        return save();
    } catch (const EAbort&) {
        return false;
    } catch (const ERukException& error) {
        const QString question = error.Message() + u"\n\n"_s + loss + u" Trotzdem beenden?"_s;
        return UserDialogs().Confirm(question, u"Beenden"_s);
    }
}

}  // namespace

CollectionCommands::CollectionCommands(TMusicDatabase& database, StandardFiles files)
    : database_(database), files_(std::move(files)), bannList_(database.BannList(), files_) {
    database_.Lock().SetWanted(true);
    handlers_ += database_.Events().BannListChanged.Subscribe(Guarded([this] { bannList_.Save(); }));
    const std::pair<int, void (CollectionCommands::*)()> commands[] = {
        {mcNew, &CollectionCommands::New},
        {mcOpen, &CollectionCommands::Open},
        {mcSave, &CollectionCommands::Save},
        {mcAddFolder, &CollectionCommands::AddFolder}};
    for (const auto& [id, command] : commands)
        handlers_ += database_.Commands().Handle(id, {.Run = [this, run = command] { (this->*run)(); }});
}

void CollectionCommands::New() {
    if (KeepChanges()) database_.OpenDatabase(QString());
}

void CollectionCommands::Open() {
    if (KeepChanges() && database_.OpenDatabaseFromDialog()) Opened();
}

void CollectionCommands::OpenFile(const QString& path) {
    if (KeepChanges() && database_.OpenDatabase(path)) Opened();
}

void CollectionCommands::Opened() {
    database_.EnsureSorted();
    if (OnOpened) OnOpened();
}

void CollectionCommands::Save() {
    SaveCurrent();
}

void CollectionCommands::AddFolder() {
    if (database_.ProgressRunning()) return;
    const auto folder =
        UserDialogs().ChooseFolder(u"Ordner zum Durchsuchen nach Songs auswählen (inkl. Unterordner):"_s);
    if (!folder) return;
    ::AddFolder(database_, *folder, true, GivenFolders::Remembered);
}

void CollectionCommands::AddPaths(const QStringList& paths) {
    AskAboutMedia(database_, paths);
    const IntakeResult result = ::AddPaths(database_, paths, true, GivenFolders::Remembered);
    if (OnIntake) OnIntake(result);
}

bool CollectionCommands::KeepChanges() {
    return MayLeave() && SaveChanges();
}

bool CollectionCommands::SaveChanges() {
    if (!database_.Modified()) return true;
    if (StandardInUse()) return SaveCurrent();
    const QString name = database_.FileName().isEmpty()
                             ? u"Die neue Datenbank"_s
                             : u"Die Datenbank "_s + QDir::toNativeSeparators(database_.FileName());
    const QString question = name + u" enthält Änderungen. Sollen sie gespeichert werden?"_s;
    const int answer = UserDialogs().Ask(
        {.Text = question, .Buttons = {u"Ja"_s, u"Nein"_s, u"Abbrechen"_s}, .Cancel = 2, .Default = 0});
    if (answer == 0) return SaveCurrent();
    return answer == 1;
}

bool CollectionCommands::MayClose() {
    const auto saveBannList = [this] {
        bannList_.Save();
        return true;
    };
    const auto saveDatabase = [this] {
        return SavedOrGivenUp([this] { return SaveChanges(); },
                              u"Die Änderungen in der Datenbank sind noch nicht gespeichert."_s);
    };
    // What is saved without a question is saved before this one, too: it may stand longer than the system
    // waits for the program to end.
    return (!StandardInUse() || saveDatabase()) && MayLeave() && saveDatabase() &&
           SavedOrGivenUp(saveBannList, u"Die Bann-Liste ist noch nicht gespeichert."_s);
}

void CollectionCommands::ForgetStandard() {
    if (StandardInUse()) database_.Clear();
}

bool CollectionCommands::StandardInUse() const {
    return database_.FileName() == files_.Database();
}

bool CollectionCommands::SaveCurrent() {
    if (StandardInUse()) files_.MakeFolder();
    return database_.SaveDatabase();
}
