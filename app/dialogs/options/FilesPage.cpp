#include "app/dialogs/options/FilesPage.h"

#include <QCheckBox>
#include <QDir>
#include <QFormLayout>
#include <QLineEdit>

#include "CommonRUKTools/AbsolutePath.h"
#include "MusicManagment/database/MusicManagment.h"
#include "app/desktop/Icons.h"
#include "app/dialogs/FolderList.h"
#include "app/dialogs/NamePatternEdit.h"
#include "app/dialogs/NamePatternTexts.h"
#include "app/dialogs/RootFolderField.h"
#include "app/dialogs/options/GenreFolderTable.h"

using namespace Qt::StringLiterals;

FilesPage::FilesPage()
    : OptionsPage(u"Dateien und Ordner"_s, ThemeIcon(u"folder-music"_s, QStyle::SP_DirIcon)) {
    QFormLayout& search = AddGroup(u"Nach Songs suchen"_s);
    folders_ = AddWide(search, u"UpdateFolders"_s, u"Diese Ordner und ihre &Unterordner"_s, new FolderList,
                       u"Die Ordner dieser Datenbank, die beim Updaten durchsucht werden. Songs aus einem "
                       "Ordner, den Sie entfernen, bleiben in der Datenbank."_s);
    QFormLayout& naming = AddGroup(u"Umbenennen und verschieben"_s);
    rename_ = AddCheck(naming, u"RenameAndMoveMP3s"_s, u"Dateien umbenennen, wenn sich ihre &Tags ändern"_s,
                       u"Gilt für Songs auf der Festplatte; Songs auf CDs behalten ihre Namen."_s);
    pattern_ = AddField(naming, u"MP3NamePattern"_s, u"&Muster der Namen"_s, new NamePatternEdit,
                        u"Text und Platzhalter. Die Endung der Datei bleibt."_s);
    root_ = AddField(naming, u"MP3MoveRootDir"_s, u"&Stammordner"_s,
                     new RootFolderField(u"Stammordner der Songs"_s));
    byGenre_ =
        AddCheck(naming, u"MoveMP3sAfterGenreChange"_s, u"Dateien in den Ordner ihres &Genres verschieben"_s,
                 u"Der Ordner liegt im Stammordner. Songs ohne Genre bleiben, wo sie sind."_s);
    connect(rename_, &QCheckBox::toggled, this, [this] { EnableNaming(); });
    QFormLayout& genres = AddGroup(u"Ordner der Genres"_s);
    genreFolders_ =
        AddWide(genres, u"MP3MoveSubDirs"_s, u"Namen der &Ordner im Stammordner"_s, new GenreFolderTable,
                u"Diese Namen gelten beim Aufnehmen auch nie als Artist."_s);
}

void FilesPage::Load(const TMusicDatabase& database, const TRWReg&) {
    folders_->SetFolders(database.UpdateFolders());
    loadedRoot_ = AbsolutePath(database.MP3MoveRootDir());
    loadedRename_ = database.RenameAndMoveMP3s();
    LoadNaming(database);
}

void FilesPage::LoadDefaults(const TMusicDatabase& database, const TRWReg&) {
    LoadNaming(database);
}

void FilesPage::LoadNaming(const TMusicDatabase& database) {
    rename_->setChecked(database.RenameAndMoveMP3s());
    byGenre_->setChecked(database.MoveMP3sAfterGenreChange());
    root_->SetFolder(AbsolutePath(database.MP3MoveRootDir()));
    pattern_->SetPattern(database.MP3NamePattern());
    genreFolders_->SetNames(database.MP3MoveSubDirs());
    EnableNaming();
}

// Asks about the folder only where something about it was changed here: who comes for another option is not
// to be bothered with it each time.
std::optional<OptionsFault> FilesPage::Check() {
    if (rename_->isChecked()) {
        if (const auto fault = FaultOfPattern(pattern_->Pattern()))
            return OptionsFault{*fault, &pattern_->Edit()};
        if (root_->Folder() != loadedRoot_ || !loadedRename_)
            if (const auto fault = root_->Fault()) return OptionsFault{*fault, &root_->Edit()};
    }
    if (const auto fault = genreFolders_->Fault()) return OptionsFault{*fault, genreFolders_};
    return std::nullopt;
}

void FilesPage::Apply(TMusicDatabase& database, TRWReg&) {
    if (folders_->Folders() != database.UpdateFolders()) {
        database.SetUpdateFolders(folders_->Folders());
        database.SetModified(true);
    }
    database.SetRenameAndMoveMP3s(rename_->isChecked());
    database.SetMoveMP3sAfterGenreChange(byGenre_->isChecked());
    // Without renaming these are not checked, and what cannot be used is not stored either.
    if (!FaultOfPattern(pattern_->Pattern())) database.SetMP3NamePattern(pattern_->Pattern());
    if (QDir::isAbsolutePath(root_->Folder())) database.SetMP3MoveRootDir(root_->Folder());
    database.SetMP3MoveSubDirs(genreFolders_->Names());
    loadedRoot_ = AbsolutePath(database.MP3MoveRootDir());
    loadedRename_ = rename_->isChecked();
}

void FilesPage::EnableNaming() {
    for (QWidget* field :
         {static_cast<QWidget*>(pattern_), static_cast<QWidget*>(root_), static_cast<QWidget*>(byGenre_)})
        field->setEnabled(rename_->isChecked());
}
