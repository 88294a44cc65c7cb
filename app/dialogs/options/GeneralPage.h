#pragma once

#include "app/dialogs/options/OptionsPage.h"

class QComboBox;

// "Allgemein": how the window behaves and the list is sorted.
class GeneralPage : public OptionsPage {
 public:
    GeneralPage();

    void Load(const TMusicDatabase& database, const TRWReg& settings) override;
    void Apply(TMusicDatabase& database, TRWReg& settings) override;

 private:
    QCheckBox* asynchronous_;
    QComboBox* sortType_;
    QComboBox* subSortType_;
    QCheckBox* sortBackwards_;
    QCheckBox* followFocus_;
};
