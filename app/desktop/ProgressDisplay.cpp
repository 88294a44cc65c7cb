#include "app/desktop/ProgressDisplay.h"

#include <QWidget>

#include "app/dialogs/ProgressWindow.h"

using namespace Qt::StringLiterals;

ProgressDisplay::ProgressDisplay(TMusicDatabase& database, QWidget& mainWindow)
    : database_(database), mainWindow_(mainWindow) {
    Operation& operation = database_.CurrentOperation();
    watched_ += operation.Started.Subscribe([this] { RunStarted(); });
    watched_ += operation.Advanced.Subscribe([this, &operation](const ProgressPoint& point) {
        if (window_) window_->ShowPoint(point, operation.MainPercent());
    });
    watched_ += operation.Ended.Subscribe([this] { RunEnded(); });
    watched_ += operation.TitleChanged.Subscribe([this] { ShowCaption(); });
    ShowCaption();
}

ProgressDisplay::~ProgressDisplay() = default;

void ProgressDisplay::RunStarted() {
    if (!window_) {
        window_ = std::make_unique<TPrgForm>(&mainWindow_);
        window_->OnStop = [this] { database_.CurrentOperation().RequestStop(); };
    }
    window_->Start();
    if (OnRunning) OnRunning(true);
}

void ProgressDisplay::RunEnded() {
    if (window_) window_->Finish();
    if (OnRunning) OnRunning(false);
}

void ProgressDisplay::ShowCaption() {
    QString caption = database_.Caption();
    mainWindow_.setWindowTitle(caption.replace(u"MusicDatabase"_s, u"Tunestead"_s));
}
