#pragma once

#include "app/dialogs/options/OptionsPage.h"

class QComboBox;
class QLineEdit;

// "Allgemein": how the window behaves and the list is sorted.
class GeneralPage : public OptionsPage {
 public:
    GeneralPage();

    std::optional<OptionsFault> Check() override;
    void Apply(TMusicDatabase& database, TRWReg& settings) override;

 private:
    void AddProgram(QFormLayout& group);

    QLineEdit* program_ = nullptr;
    QComboBox* sortType_;
    QComboBox* subSortType_;
    QCheckBox* sortBackwards_;
};
