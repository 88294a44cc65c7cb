#include "app/dialogs/ReportDisplay.h"

#include <QMainWindow>
#include <QStatusBar>
#include <QToolButton>

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

// The button stays as long as its line.
void ReportDisplay::TellInStatusBar(const Report& report, QMainWindow& window) {
    QStatusBar& bar = *window.statusBar();
    bar.clearMessage();  // hides the button of the report before
    told_ = report;
    if (details_ == nullptr) {
        details_ = new QToolButton(&window);
        details_->setObjectName(u"reportDetails"_s);
        details_->setText(u"Details"_s);
        details_->setToolTip(u"Zeigt, welche Songs es sind"_s);
        bar.insertPermanentWidget(0, details_);
        QObject::connect(details_, &QToolButton::clicked, &window,
                         [this, &window] { OpenWindow(told_, &window); });
        QObject::connect(&bar, &QStatusBar::messageChanged, details_, &QToolButton::hide);
    }
    bar.showMessage(QString(report.Message).replace(u'\n', u' '));
    details_->setVisible(!report.Sections.empty());
}
