#include "app/Startup.h"

#include <QFileInfo>

#include "CommonRUKTools/CommandRunner.h"
#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/intake/Intake.h"
#include "app/CollectionCommands.h"
#include "app/desktop/InstallationSteps.h"

using namespace Qt::StringLiterals;

namespace {

enum class Step { OpenFiles, Install, Uninstall };

// Only the first argument can ask for a step.
Step StepOf(const QStringList& arguments) {
    const QString first = arguments.value(0).toLower();
    if (first == u"-install"_s || first == u"/install"_s) return Step::Install;
    if (first == u"-uninstall"_s || first == u"/uninstall"_s) return Step::Uninstall;
    return Step::OpenFiles;
}

void Warn(const QString& text) {
    UserDialogs().ShowMessage(MessageKind::Warning, text);
}

}  // namespace

// A start for the removal alone ends the program even when the user has kept everything.
bool Startup::Run(const QStringList& arguments) {
    if (!OpenStandardDatabase()) return false;
    OpenStandardLists();
    RunCommand([this] { installation_.Refresh(); });
    return ActOn(arguments) && StepOf(arguments) != Step::Uninstall;
}

bool Startup::ActOn(const QStringList& arguments) {
    switch (StepOf(arguments)) {
        case Step::Install:
            RunCommand([this] { installation_.Install(LinkFolder); });
            return true;
        case Step::Uninstall:
            return !Uninstall();
        default:
            OpenFiles(arguments);
            return true;
    }
}

// Without the file the standard database is an empty one, which closing the program will save there.
bool Startup::OpenStandardDatabase() {
    const QString path = commands_.Files().Database();
    const bool complete = !QFileInfo::exists(path) || ReadStandardDatabase();
    const QString question =
        u"Die Standard-Datenbank wurde nicht komplett importiert. Wenn Sie nun fortfahren, wird beim Beenden "
        "die Standard-Datenbank auf der Festplatte mit der nur halb importierten überschrieben => Die noch "
        "nicht importierten Songs gehen (in der Datenbank) verloren. Trotzdem fortfahren?"_s;
    if (!complete && !UserDialogs().AskYesNo(question)) {
        database_.Clear();  // so that the half of it is not saved
        return false;
    }
    // Each command saves into it when the user wants that.
    RunCommand([this] { commands_.Files().MakeFolder(); });
    database_.SetFileName(path);
    if (!database_.Lock().IsElsewhere()) database_.Lock().Claim(path);  // there may be no file yet
    return true;
}

bool Startup::ReadStandardDatabase() {
    bool complete = false;
    RunCommand([&] {
        complete = database_.OpenDatabase(commands_.Files().Database());
        database_.EnsureSorted();
    });
    return complete;
}

void Startup::OpenStandardLists() {
    RunCommand([this] { commands_.BannList().Load(); });
    RunCommand(OpenStandardPlayList);
}

bool Startup::Uninstall() {
    RunCommand([this] { installation_.Uninstall(LinkFolder); });
    const RemovalChoice& removed = installation_.Removed();
    if (removed.Database) commands_.ForgetStandard();
    if (removed.Lists) commands_.BannList().Forget();
    return removed.Program;
}

// The player has one current file, so further songs are taken into the collection, as folders are.
void Startup::OpenFiles(const QStringList& arguments) {
    QStringList intake;
    bool songOpened = false;
    for (const QString& argument : arguments) {
        const QFileInfo file(argument);
        const QString path = file.absoluteFilePath();
        const FileKind kind = KindOfFile(path);
        if (!file.exists()) {
            RunCommand([&] { throw EMusicDatabaseException(u"Datei nicht gefunden: "_s + path); });
        } else if (!songOpened && kind == FileKind::Song && !file.isDir()) {
            RunCommand([&] { OpenSong(path); });
            songOpened = true;
        } else if (file.isDir() || IsSongFile(path)) {
            intake << path;
        } else if (kind == FileKind::Song) {
            Warn(u"Diese Datei kann nicht in die Datenbank aufgenommen werden: "_s + path);
        } else {
            OpenFile(kind, path);
        }
    }
    if (!intake.isEmpty()) RunCommand([&] { commands_.AddPaths(intake); });
}

void Startup::OpenFile(FileKind kind, const QString& path) {
    const auto open = [&path](const std::function<void(const QString&)>& opener) {
        RunCommand([&] { opener(path); });
    };
    if (kind == FileKind::Database) return OfferDatabase(path);
    if (kind == FileKind::PlayList) return open(OpenPlayList);
    if (kind == FileKind::Arrangement) return open(OpenArrangement);
    Warn(u"Unbekannter Dateityp: "_s + FileExtension(path));
}

void Startup::OfferDatabase(const QString& path) {
    const QString question = u"Soll diese Datenbank nun geladen werden:\r\n"_s + path;
    if (!UserDialogs().AskYesNo(question, ReturnKey::Agrees)) return;
    RunCommand([&] { commands_.OpenFile(path); });
}
