#pragma once

#include <QPointer>
#include <QString>
#include <functional>

class QMainWindow;
class QToolButton;

// A button in the status bar for what can be done about the line that stands there. It goes with that line.
class StatusAction {
 public:
    explicit StatusAction(QString objectName) : objectName_(std::move(objectName)) {}

    // Call it after the line is shown.
    void Show(QMainWindow& window, const QString& caption, const QString& toolTip, std::function<void()> run);

 private:
    void Make(QMainWindow& window);

    QString objectName_;
    QPointer<QToolButton> button_;
    std::function<void()> run_;
};
