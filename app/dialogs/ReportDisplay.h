#pragma once

#include <QPointer>

#include "CommonRUKTools/Dialogs.h"
#include "app/views/StatusAction.h"

class QMainWindow;
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
    StatusAction details_{QStringLiteral("reportDetails")};
    Report told_;  // that the button stands for
};
