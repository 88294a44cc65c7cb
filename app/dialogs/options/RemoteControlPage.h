#pragma once

#include "app/dialogs/options/OptionsPage.h"

// "Fernsteuerung": a setting of the remote control, which that component reads from the store.
class RemoteControlPage : public OptionsPage {
 public:
    // The group is greyed out where `database` is not linked to a remote control.
    explicit RemoteControlPage(const TMusicDatabase& database);
};
