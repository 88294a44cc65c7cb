#pragma once

#include "app/dialogs/options/OptionsPage.h"

class FolderList;
class GenreFolderTable;
class NamePatternEdit;
class RootFolderField;

// "Dateien und Ordner": where songs are searched, and how their files are named and placed.
class FilesPage : public OptionsPage {
 public:
    FilesPage();

    void Load(const TMusicDatabase& database, const TRWReg& settings) override;
    std::optional<OptionsFault> Check() override;
    void Apply(TMusicDatabase& database, TRWReg& settings) override;
    void LoadDefaults(const TMusicDatabase& database, const TRWReg& settings) override;

 private:
    void LoadNaming(const TMusicDatabase& database);
    void EnableNaming();

    FolderList* folders_;
    QCheckBox* rename_;
    QCheckBox* byGenre_;
    RootFolderField* root_;
    NamePatternEdit* pattern_;
    GenreFolderTable* genreFolders_;
    QString loadedRoot_;
    bool loadedRename_ = false;
};
