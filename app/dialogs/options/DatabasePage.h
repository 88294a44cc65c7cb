#pragma once

#include "app/dialogs/options/OptionsPage.h"

class DurationBox;
class QComboBox;

// "Datenbank": when and how the collection is saved, and what becomes of banned songs.
class DatabasePage : public OptionsPage {
 public:
    DatabasePage();

    void Load(const TMusicDatabase& database, const TRWReg& settings) override;
    void Apply(TMusicDatabase& database, TRWReg& settings) override;

 private:
    QComboBox* autoSave_;
    DurationBox* interval_;
    QComboBox* compression_;
    QCheckBox* deleteBanned_;
};
