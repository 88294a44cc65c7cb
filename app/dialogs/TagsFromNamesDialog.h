#pragma once

#include "MusicManagment/database/batches/TagsFromNames.h"
#include "app/dialogs/PatternDialog.h"

// Asks for the pattern by which the names of files are read and shows what the fields of the tags become.
class TagsFromNamesDialog : public PatternDialog {
 public:
    TagsFromNamesDialog(const TMusicDatabase& database, std::vector<SongHandle> songs, const QString& pattern,
                        QWidget* parent = nullptr);

 protected:
    PatternOutcome Plan(const QString& pattern) override;
    QVariant Cell(std::size_t row, int column, int role) const override;

 private:
    QVariant NameCell(const QString& path, int role) const;
    QVariant FieldCell(const TID3Tag& before, const PlannedTags& plan, SongFieldId id, int role) const;

    const TMusicDatabase& database_;
    std::vector<SongHandle> songs_;
    std::vector<SongFieldId> fields_;  // of the pattern
    qsizetype folders_ = 0;
    std::vector<PlannedTags> plans_;
};
