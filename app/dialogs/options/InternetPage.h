#pragma once

#include "app/dialogs/options/OptionsPage.h"

class QComboBox;
class QLineEdit;

// "Internet": whom the search asks.
class InternetPage : public OptionsPage {
 public:
    InternetPage();

    std::optional<OptionsFault> Check() override;

 private:
    QComboBox* service_;
    QLineEdit* host_;
    QLineEdit* musicBrainz_;
    QLineEdit* coverArt_;
};
