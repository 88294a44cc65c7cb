#include "MusicManagment/database/batches/LyricsTool.h"

#include <QDir>
#include <QFileInfo>
#include <QStandardPaths>

#include "CommonRUKTools/Clock.h"
#include "CommonRUKTools/Dialogs.h"
#include "CommonRUKTools/Shell.h"
#include "CommonRUKTools/SortedTextList.h"
#include "MusicManagment/database/Progress.h"

using namespace Qt::StringLiterals;

namespace {

constexpr qint64 kProgressEvery = 50;  // milliseconds

const QString kName = u"LyrikfangDownloader"_s;

QStringList TextsOf(const SortedTextList& list) {
    QStringList texts;
    for (const auto& row : list)
        texts << row.Text;
    return texts;
}

}  // namespace

QString FindLyricsTool(const LyricsToolPlaces& places) {
    const QStringList names = {kName + u".exe"_s, kName};
    QStringList folders = {places.ProgramFolder, places.ProgramFolder + u'/' + kName};
    if (!places.StoredFolder.isEmpty()) folders << places.StoredFolder;
    for (const QString& folder : folders) {
        for (const QString& name : names) {
            const QFileInfo file(folder, name);
            if (file.isFile() && file.isExecutable()) return file.filePath();
        }
    }
    for (const QString& name : names)
        if (QString path = QStandardPaths::findExecutable(name); !path.isEmpty()) return path;
    return {};
}

QStringList ArtistsOf(TMusicDatabase& database, const BatchSongs& songs) {
    std::optional<ProgressRun> run;
    if (songs.Range != BatchRange::One) run.emplace(database, u"Suche Interpreten für Lyrik-Download"_s);
    SortedTextList artists;
    qint64 nextPoint = 0;
    for (std::size_t i = 0; i < songs.Songs.size(); ++i) {
        const TID3Tag* song = database.Songs().Find(songs.Songs[i]);
        if (song != nullptr && !song->Artist.isEmpty()) artists.Insert(song->Artist);
        const qint64 now = CurrentClock().Ticks();
        if (!run || now < nextPoint) continue;
        nextPoint = now + kProgressEvery;
        if (database.Progress(
                {.Cur = static_cast<qint64>(i + 1), .Max = static_cast<qint64>(songs.Songs.size())}))
            throw EAbort();
    }
    return TextsOf(artists);
}

QString LyricsCommandLine(const QStringList& artists) {
    QStringList words = artists;
    for (QString& word : words)
        if (word.contains(u' ') || word.contains(u'"')) word = u'"' + word + u'"';
    return words.join(u' ');
}

QString LoadLyrics(TMusicDatabase& database, const BatchSongs& songs, const LyricsToolPlaces& places) {
    const QStringList artists = ArtistsOf(database, songs);
    const QString tool = FindLyricsTool(places);
    if (tool.isEmpty()) {
        UserDialogs().ShowMessage(
            MessageKind::Error, u"Kann das dafür benötigte Programm LyrikfangDownloader.exe nicht finden"_s);
        return {};
    }
    if (!CurrentShell().StartProgram(tool, artists))
        throw EMusicDatabaseException(u"Kann das Programm nicht starten: "_s + tool);
    return tool + u' ' + LyricsCommandLine(artists);
}
