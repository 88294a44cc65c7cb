#pragma once

#include <QDialog>
#include <functional>

#include "MusicManagment/database/Progress.h"
#include "app/dialogs/RemainingTime.h"

class ElidedLabel;
class QLabel;
class QProgressBar;
class QPushButton;

// Shows how far a long operation has come. Its stop button, Escape and closing it ask the operation to stop;
// only the operation's end closes it.
class TPrgForm : public QDialog {
 public:
    explicit TPrgForm(QWidget* parent);

    std::function<void()> OnStop;

    // Begins the estimate of the remaining time and shows the window.
    void Start();
    // The first point of a stage and the last are always shown, those between a few times a second.
    void ShowPoint(const ProgressPoint& point, int percent);
    void Reset();
    void Finish();

    void reject() override;

 private:
    void SetUpLayout();
    void ShowRemaining(std::optional<int> seconds);

    QLabel* heading_;
    QProgressBar* mainBar_;
    ElidedLabel* mainLabel_;
    QProgressBar* subBar_;
    ElidedLabel* subLabel_;
    QLabel* remaining_;
    QPushButton* stop_;
    RemainingTime estimate_;
    TProgressType shownType_ = ptOther;
    qint64 shownMax_ = -1;
    qint64 shownAt_ = 0;  // ticks of the clock
};
