#pragma once

#include "app/dialogs/options/OptionsPage.h"

// "Konvertierung": the program that makes WMA. What is chosen anew each time stands in the command's dialog.
class ConversionPage : public OptionsPage {
 public:
    ConversionPage();

    std::optional<OptionsFault> Check() override;

 private:
    QLineEdit* script_;
};
