#pragma once

#include <QPointer>

#include "CommonRUKTools/Dialogs.h"

class QMainWindow;
class QToolButton;
class QWidget;
class ReportWindow;

// Shows reports where they disturb as little as they may: as a line in the status bar with a button for the
// details, which complaints open at once.
class ReportDisplay {
 public:
    // Without a main window every report has a window of its own.
    void Show(const Report& report, QWidget* mainWindow);

 private:
    void OpenWindow(const Report& report, QWidget* parent);
    void TellInStatusBar(const Report& report, QMainWindow& window);

    QPointer<ReportWindow> window_;
    QPointer<QToolButton> details_;
    Report told_;  // that the button stands for
};
