#include "app/views/StatusAction.h"

#include <QMainWindow>
#include <QStatusBar>
#include <QToolButton>

#include "CommonRUKTools/CommandRunner.h"

void StatusAction::Show(QMainWindow& window, const QString& caption, const QString& toolTip,
                        std::function<void()> run) {
    if (button_ == nullptr) Make(window);
    button_->setText(caption);
    button_->setToolTip(toolTip);
    run_ = std::move(run);
    button_->show();
}

void StatusAction::Make(QMainWindow& window) {
    button_ = new QToolButton(&window);
    button_->setObjectName(objectName_);
    QStatusBar& bar = *window.statusBar();
    bar.insertPermanentWidget(0, button_);
    QObject::connect(button_, &QToolButton::clicked, &window, Guarded([this] {
                         const auto run = run_;  // it may show another line
                         run();
                     }));
    QObject::connect(&bar, &QStatusBar::messageChanged, button_, &QToolButton::hide);
}
