#include "app/dialogs/wizard/WizardChoice.h"

#include <QFileInfo>

#include "CommonRUKTools/AbsolutePath.h"
#include "CommonRUKTools/MusicFolder.h"
#include "MusicManagment/database/MusicManagment.h"

WizardChoice FirstChoice(const TMusicDatabase& database) {
    WizardChoice choice = CurrentChoice(database);
    choice.RenameAndMove = false;
    const QString music = MusicFolder();
    if (choice.Folders.isEmpty() && QFileInfo(music).isDir()) choice.Folders << AbsolutePath(music);
    return choice;
}

WizardChoice CurrentChoice(const TMusicDatabase& database) {
    return {.Folders = database.UpdateFolders(),
            .RenameAndMove = database.RenameAndMoveMP3s(),
            .RootFolder = AbsolutePath(database.MP3MoveRootDir()),
            .Pattern = database.MP3NamePattern(),
            .RenameInPlace = database.RenameInPlace(),
            .GenreFolders = database.MP3MoveSubDirs(),
            .Example = RenameExample(database)};
}

void ApplyChoice(const WizardChoice& choice, TMusicDatabase& database) {
    if (choice.Folders != database.UpdateFolders()) {
        database.SetUpdateFolders(choice.Folders);
        database.SetModified(true);
    }
    database.SetRenameAndMoveMP3s(choice.RenameAndMove);
    if (!choice.RenameAndMove) return;
    // Files are moved into the genre folders below the root folder; without them nothing would be moved
    // there.
    database.SetMoveMP3sAfterGenreChange(true);
    database.SetMP3MoveRootDir(choice.RootFolder);
    database.SetMP3NamePattern(choice.Pattern);
    database.SetRenameInPlace(choice.RenameInPlace);
}
