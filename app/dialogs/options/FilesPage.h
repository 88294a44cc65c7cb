#pragma once

#include "app/dialogs/RenameExample.h"
#include "app/dialogs/options/OptionsPage.h"

class FolderList;
class GenreFolderTable;
class NamePatternEdit;
class QLabel;
class RootFolderField;

// "Dateien und Ordner": where songs are searched, and how their files are named and placed.
class FilesPage : public OptionsPage {
 public:
    FilesPage();

    void Load(const TMusicDatabase& database, const TRWReg& settings) override;
    std::optional<OptionsFault> Check() override;
    void Apply(TMusicDatabase& database, TRWReg& settings) override;
    void LoadDefaults() override;

 private:
    void ShowNaming(const QString& root, const QString& pattern, const QStringList& genreFolders);
    void RememberShown();
    void EnableNaming();
    void ShowExample();

    FolderList* folders_;
    QCheckBox* rename_;
    QCheckBox* byGenre_;
    QCheckBox* inPlace_;
    QLabel* placeExample_;
    RenameExample example_;
    RootFolderField* root_;
    NamePatternEdit* pattern_;
    GenreFolderTable* genreFolders_ = nullptr;
    // What was shown at first: who touches nothing changes nothing.
    QString loadedRoot_;
    QString loadedPattern_;
    QStringList loadedGenreFolders_;
    bool loadedRename_ = false;
};
