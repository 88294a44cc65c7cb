#pragma once

#include <QString>
#include <QStringList>

#include "MusicManagment/database/SongTypes.h"
#include "app/dialogs/RenameExample.h"

class TMusicDatabase;

// What the user chooses when the collection is set up.
struct WizardChoice {
    QStringList Folders{};  // where songs are searched, with their sub-folders
    bool RenameAndMove = false;
    QString RootFolder{};
    QString Pattern{};
    bool ScanNow = true;
    bool RenameInPlace = true;  // where no genre folder is a file's place
    QStringList GenreFolders = DefaultGenreFolderNames();
    RenameExample Example{};
};

// What is proposed at the first start: the user's music folder, where there is one, and files that stay as
// they are.
WizardChoice FirstChoice(const TMusicDatabase& database);
// What is set now.
WizardChoice CurrentChoice(const TMusicDatabase& database);

// Sets the folders and the naming of the database. Does not search.
void ApplyChoice(const WizardChoice& choice, TMusicDatabase& database);
