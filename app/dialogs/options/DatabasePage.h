#pragma once

#include "app/dialogs/options/OptionsPage.h"

class DurationBox;
class QComboBox;

// "Datenbank": when and how the collection is saved, and what becomes of banned songs.
class DatabasePage : public OptionsPage {
 public:
    DatabasePage();

 private:
    void ShowAutoSave(int autoSave);
    int ChosenAutoSave() const;

    QComboBox* autoSave_;
    DurationBox* interval_;
};
