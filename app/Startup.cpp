#include "app/Startup.h"

#include <QFileInfo>

#include "CommonRUKTools/Dialogs.h"
#include "MusicManagment/database/Intake.h"
#include "MusicManagment/database/MusicManagment.h"
#include "app/CollectionCommands.h"
#include "app/CommandRunner.h"

using namespace Qt::StringLiterals;

bool Startup::Run(const QStringList& arguments) {
    if (!OpenStandardDatabase()) return false;
    if (OnOpened) OnOpened();
    ActOn(arguments);
    return true;
}

// Without the file the standard database is an empty one, which closing the program will save there.
bool Startup::OpenStandardDatabase() {
    const QString path = commands_.Files().Database();
    const bool complete = !QFileInfo::exists(path) || ReadStandardDatabase();
    if (!complete) {
        const int answer = UserDialogs().Ask(
            u"Die Standard-Datenbank wurde nicht komplett importiert. Wenn Sie nun fortfahren, wird beim "
            "Beenden die Standard-Datenbank auf der Festplatte mit der nur halb importierten überschrieben "
            "=> "
            "Die noch nicht importierten Songs gehen (in der Datenbank) verloren. Trotzdem fortfahren?"_s,
            {u"Ja"_s, u"Nein"_s}, 1);
        if (answer != 0) {
            database_.Clear();  // so that the half of it is not saved
            return false;
        }
    }
    database_.SetFileName(path);
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

void Startup::ActOn(const QStringList& arguments) {
    QStringList songs;
    for (const QString& argument : arguments) {
        const QFileInfo file(argument);
        const QString path = file.absoluteFilePath();
        if (!file.exists())
            RunCommand([&] { throw EMusicDatabaseException(u"Datei nicht gefunden: "_s + path); });
        else if (file.isDir() || IsSongFile(path))
            songs << path;
        else if (file.suffix().toLower() == u"tsdb"_s)
            OfferDatabase(path);
        else
            UserDialogs().ShowMessage(MessageKind::Warning, u"Unbekannter Dateityp: ."_s + file.suffix());
    }
    if (!songs.isEmpty()) RunCommand([&] { commands_.AddPaths(songs); });
}

void Startup::OfferDatabase(const QString& path) {
    const QString question = u"Soll diese Datenbank nun geladen werden:\r\n"_s + path;
    if (UserDialogs().Ask(question, {u"Ja"_s, u"Nein"_s}, 1) != 0) return;
    RunCommand([&] { commands_.OpenFile(path); });
}
