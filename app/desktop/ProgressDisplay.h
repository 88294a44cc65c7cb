#pragma once

#include <functional>
#include <memory>

#include "MusicManagment/database/MusicManagment.h"

class QWidget;
class TPrgForm;

// Shows the database's long operations: the progress window while one goes, and the database's caption as the
// title of the main window.
class ProgressDisplay {
 public:
    ProgressDisplay(TMusicDatabase& database, QWidget& mainWindow);
    ~ProgressDisplay();

    // Told when a run begins and when it has ended.
    std::function<void(bool running)> OnRunning;

 private:
    void RunStarted();
    void RunEnded();
    void ShowCaption();

    TMusicDatabase& database_;
    QWidget& mainWindow_;
    std::unique_ptr<TPrgForm> window_;  // made for the first run
    Subscriptions watched_;
};
