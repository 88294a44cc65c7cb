#pragma once

#include <QDialog>

#include "CommonRUKTools/Dialogs.h"

// Shows a report with a page for each of its sections, beside the other windows: nobody has to answer it.
class ReportWindow : public QDialog {
 public:
    explicit ReportWindow(Report report, QWidget* parent = nullptr);

 private:
    QWidget* MakePages();

    const Report report_;
};
