#pragma once

#include "app/dialogs/options/OptionsPage.h"

class QRadioButton;

// "Tags": how files are read.
class TagsPage : public OptionsPage {
 public:
    TagsPage();

    void Load(const TMusicDatabase& database, const TRWReg& settings) override;
    void Apply(TMusicDatabase& database, TRWReg& settings) override;

 private:
    QRadioButton* modern_;
    QRadioButton* classic_;
};
