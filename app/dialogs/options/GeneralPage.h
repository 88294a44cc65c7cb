#pragma once

#include "app/dialogs/options/OptionsPage.h"

class QComboBox;

// "Allgemein": how the window behaves and the list is sorted.
class GeneralPage : public OptionsPage {
 public:
    GeneralPage();

    void Apply(TMusicDatabase& database, TRWReg& settings) override;

 private:
    QComboBox* sortType_;
    QComboBox* subSortType_;
    QCheckBox* sortBackwards_;
};
