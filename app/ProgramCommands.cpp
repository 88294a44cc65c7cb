#include "app/ProgramCommands.h"

#include <QCoreApplication>

#include "CommonRUKTools/CommandDispatcher.h"
#include "CommonRUKTools/FileSource.h"
#include "CommonRUKTools/RWReg.h"
#include "CommonRUKTools/Shell.h"
#include "MusicManagment/database/Command.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/batches/LyricsTool.h"
#include "app/SongChoice.h"
#include "app/views/SongListWidget.h"
#include "app/views/WindowSettings.h"

using namespace Qt::StringLiterals;

namespace {

// What the tool has stored of itself.
constexpr QStringView kLyricsKey = u"\\Software\\RUK\\Lyrikfang Downloader";
constexpr QStringView kLyricsFolder = u"Path";

}  // namespace

ProgramCommands::ProgramCommands(TMusicDatabase& database, SongListWidget& list, const QString& settingsFile)
    : database_(database), list_(list), settingsFile_(settingsFile) {
    database_.JoinSettings(*this);
    handlers_ += database_.Commands().Handle(mcOpenExternally, {.Run = [this] { OpenSong(); }});
    handlers_ += database_.Commands().Handle(mcLoadLyrics, {.Run = [this] { LoadLyrics(); }});
}

void ProgramCommands::LoadSettings(const TRWReg& settings) {
    program_ = ReadSetting(settings, WindowSettings::kExternalProgram).value_or(program_);
}

void ProgramCommands::SaveSettings(TRWReg& settings) const {
    WriteSetting(settings, WindowSettings::kExternalProgram, program_);
}

void ProgramCommands::OpenSong() {
    const SongIndex song = list_.FocusedSong();
    if (song < 0) return;
    const QString path = database_.ResolveSongPath(database_.Song(song).FileName);
    if (path.isEmpty()) return;  // the user has no such medium at hand
    // The desktop's starter would find that out where nobody hears of it.
    if (!FileSource::Exists(path)) throw EMusicDatabaseException(u"Datei nicht gefunden: "_s + path);
    if (program_.isEmpty()) {
        if (!CurrentShell().OpenWithDefaultProgram(path))
            throw EMusicDatabaseException(u"Kann kein Programm für diese Datei starten: "_s + path);
    } else if (!CurrentShell().StartProgram(program_, {path})) {
        throw EMusicDatabaseException(
            u"Kann das Programm nicht starten, das in den Einstellungen genannt ist: "_s + program_);
    }
}

void ProgramCommands::LoadLyrics() {
    const auto songs =
        AskForSongs(database_, list_, u"Alle Songs"_s, u"Markierte Songs"_s, SongPreset::Marked);
    if (!songs || songs->IsEmpty()) return;
    const TRWReg stored(kLyricsKey.toString(), settingsFile_);
    const QString started =
        ::LoadLyrics(database_, *songs,
                     {.ProgramFolder = QCoreApplication::applicationDirPath(),
                      .StoredFolder = stored.ReadString(kLyricsFolder.toString()).value_or(QString())});
    if (!started.isEmpty() && OnDone) OnDone(u"Gestartet: "_s + started);
}
