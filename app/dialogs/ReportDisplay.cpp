#include "app/dialogs/ReportDisplay.h"

#include <QMainWindow>
#include <QStatusBar>

#include "app/dialogs/ReportWindow.h"

using namespace Qt::StringLiterals;

void ReportDisplay::Show(const Report& report, QWidget* mainWindow) {
    auto* window = qobject_cast<QMainWindow*>(mainWindow);
    if (window != nullptr) TellInStatusBar(report, *window);
    if (window == nullptr || report.HasComplaints()) OpenWindow(report, mainWindow);
}

// One window is enough: the latest report takes the place of the one before.
void ReportDisplay::OpenWindow(const Report& report, QWidget* parent) {
    delete window_;
    window_ = new ReportWindow(report, parent);
    window_->setAttribute(Qt::WA_DeleteOnClose);
    window_->show();
}

void ReportDisplay::TellInStatusBar(const Report& report, QMainWindow& window) {
    told_ = report;
    window.statusBar()->clearMessage();  // the same line again counts as a new one
    window.statusBar()->showMessage(QString(report.Message).replace(u'\n', u' '));
    if (!report.Sections.empty())
        details_.Show(window, u"Details"_s, u"Zeigt, welche Songs es sind"_s,
                      [this, &window] { OpenWindow(told_, &window); });
}
