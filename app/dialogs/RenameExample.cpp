#include "app/dialogs/RenameExample.h"

#include <QDir>
#include <algorithm>

#include "CommonRUKTools/MusicFolder.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/songfiles/RenameTarget.h"
#include "app/dialogs/NamePatternTexts.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kMostLookedAt = 1000;

TID3Tag InventedSong() {
    TID3Tag song = ExampleSong();
    song.FileName = QDir::cleanPath(MusicFolder() + u"/Sommer/lied04.mp3"_s);
    song.MainGenre = 0;
    return song;
}

}  // namespace

QString Breakable(const QString& path) {
    constexpr QChar kZeroWidthSpace(0x200B);
    QString text = QDir::toNativeSeparators(path);
    return text.replace(QDir::separator(), QString(QDir::separator()) + kZeroWidthSpace);
}

RenameExample::RenameExample() : song_(InventedSong()) {}

RenameExample::RenameExample(const TMusicDatabase& database) : song_(InventedSong()) {
    bool isOfCollection = false;
    for (SongIndex i = 0; i < std::min(database.Count(), kMostLookedAt); ++i) {
        const TID3Tag& song = database.Song(i);
        if (IsCdPath(song.FileName) || (isOfCollection && song.MainGenre != 0)) continue;
        song_ = song;
        isOfCollection = true;
        if (song.MainGenre == 0) return;
    }
}

// The rules are the database's own: one that has nothing but these settings is asked.
QString RenameExample::Text(const NamingChoice& choice) const {
    TMusicDatabase rules;
    rules.SetMP3MoveRootDir(choice.RootFolder);
    rules.SetMoveMP3sAfterGenreChange(choice.ByGenre);
    rules.SetMP3MoveSubDirs(choice.GenreFolders);
    rules.SetRenameInPlace(choice.InPlace);
    const QString target = RenameTargetByPattern(rules, choice.Pattern, song_.FileName, song_);
    if (target == song_.FileName) return u"Beispiel: %1 bleibt, wie es ist."_s.arg(Breakable(target));
    return u"Beispiel: Aus %1 wird %2"_s.arg(Breakable(song_.FileName), Breakable(target));
}
