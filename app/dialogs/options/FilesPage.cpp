#include "app/dialogs/options/FilesPage.h"

#include <QCheckBox>
#include <QDir>
#include <QFormLayout>
#include <QLineEdit>

#include "CommonRUKTools/AbsolutePath.h"
#include "MusicManagment/database/commands/DatabaseSettings.h"
#include "MusicManagment/database/songfiles/NamePattern.h"
#include "app/desktop/Icons.h"
#include "app/dialogs/FolderList.h"
#include "app/dialogs/NamePatternEdit.h"
#include "app/dialogs/NamePatternTexts.h"
#include "app/dialogs/RootFolderField.h"
#include "app/dialogs/options/GenreFolderTable.h"
#include "app/views/WrappedLabel.h"

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
                 u"Der Ordner liegt im Stammordner und gilt für Songs mit einem Hauptgenre."_s);
    inPlace_ = AddCheck(naming, u"KeepFolders"_s, u"Dateien beim Umbenennen in ihrem Ordner &lassen"_s,
                        u"Gilt für Songs, die kein Ordner eines Genres aufnimmt. Sonst kommen sie mit ihrem "
                        "ganzen alten Pfad unter den Stammordner, wie in den früheren Versionen."_s);
    placeExample_ = new WrappedLabel(u"placeExample"_s);
    naming.addRow(placeExample_);
    fields_.Bind(rename_, DatabaseSettings::kRenameAndMoveMP3s);
    fields_.Bind(byGenre_, DatabaseSettings::kMoveMP3sAfterGenreChange);
    fields_.Bind(inPlace_, DatabaseSettings::kRenameInPlace);
    connect(rename_, &QCheckBox::toggled, this, [this] { EnableNaming(); });
    for (const QCheckBox* rule : {byGenre_, inPlace_})
        connect(rule, &QCheckBox::toggled, this, [this] { ShowExample(); });
    for (const QLineEdit* field : {&pattern_->Edit(), &root_->Edit()})
        connect(field, &QLineEdit::textChanged, this, [this] { ShowExample(); });
    QFormLayout& genres = AddGroup(u"Ordner der Genres"_s);
    genreFolders_ =
        AddWide(genres, u"MP3MoveSubDirs"_s, u"Namen der &Ordner im Stammordner"_s, new GenreFolderTable,
                u"Diese Namen gelten beim Aufnehmen auch nie als Artist."_s);
}

void FilesPage::Load(const TMusicDatabase& database, const TRWReg& settings) {
    OptionsPage::Load(database, settings);
    example_ = RenameExample(database);
    folders_->SetFolders(database.UpdateFolders());
    ShowNaming(database.MP3MoveRootDir(), database.MP3NamePattern(), database.MP3MoveSubDirs());
    RememberShown();
}

void FilesPage::LoadDefaults() {
    OptionsPage::LoadDefaults();
    const TMusicDatabase fresh;
    ShowNaming(fresh.MP3MoveRootDir(), fresh.MP3NamePattern(), DefaultGenreFolderNames());
}

void FilesPage::ShowNaming(const QString& root, const QString& pattern, const QStringList& genreFolders) {
    root_->SetFolder(AbsolutePath(root));
    pattern_->SetPattern(pattern);
    genreFolders_->SetNames(genreFolders);
    EnableNaming();
    ShowExample();
}

void FilesPage::RememberShown() {
    loadedRoot_ = root_->Folder();
    loadedPattern_ = pattern_->Pattern();
    loadedGenreFolders_ = genreFolders_->Names();
    loadedRename_ = rename_->isChecked();
}

// Only what was changed here is looked at: who comes for another option is not to be bothered with the rest
// each time.
std::optional<OptionsFault> FilesPage::Check() {
    if (rename_->isChecked()) {
        const bool begins = !loadedRename_;
        if (begins || pattern_->Pattern() != loadedPattern_)
            if (const auto fault = FaultOfPattern(pattern_->Pattern()))
                return OptionsFault{*fault, &pattern_->Edit()};
        if (begins || root_->Folder() != loadedRoot_)
            if (const auto fault = root_->Fault()) return OptionsFault{*fault, &root_->Edit()};
    }
    if (genreFolders_->Names() != loadedGenreFolders_)
        if (const auto fault = genreFolders_->Fault()) return OptionsFault{*fault, genreFolders_};
    return std::nullopt;
}

void FilesPage::Apply(TMusicDatabase& database, TRWReg& settings) {
    if (folders_->Folders() != database.UpdateFolders()) {
        database.SetUpdateFolders(folders_->Folders());
        database.SetModified(true);
    }
    OptionsPage::Apply(database, settings);
    // Without renaming these are not checked, and what cannot be used is not stored either.
    const QString pattern = pattern_->Pattern();
    if (pattern != loadedPattern_ && !FaultOfPattern(pattern)) database.SetMP3NamePattern(pattern);
    const QString root = root_->Folder();
    if (root != loadedRoot_ && QDir::isAbsolutePath(root)) database.SetMP3MoveRootDir(root);
    if (genreFolders_->Names() != loadedGenreFolders_) database.SetMP3MoveSubDirs(genreFolders_->Names());
    RememberShown();
}

void FilesPage::EnableNaming() {
    for (QWidget* field : std::initializer_list<QWidget*>{pattern_, root_, byGenre_, inPlace_, placeExample_})
        field->setEnabled(rename_->isChecked());
}

void FilesPage::ShowExample() {
    if (genreFolders_ == nullptr) return;  // the page is still being made
    placeExample_->setText(example_.Text({.Pattern = pattern_->Pattern(),
                                          .RootFolder = root_->Folder(),
                                          .ByGenre = byGenre_->isChecked(),
                                          .GenreFolders = genreFolders_->Names(),
                                          .InPlace = inPlace_->isChecked()}));
}
