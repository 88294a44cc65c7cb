#include "app/desktop/ProgressDisplay.h"

#include <QWidget>

#include "app/dialogs/ProgressWindow.h"

using namespace Qt::StringLiterals;

ProgressDisplay::ProgressDisplay(TMusicDatabase& database, QWidget& mainWindow)
    : database_(database), mainWindow_(mainWindow) {
    database_.OnStartProgress = [this](TMusicDatabase&) { RunStarted(); };
    database_.OnProgress = [this](TMusicDatabase&, const ProgressPoint& point) {
        if (window_) window_->ShowPoint(point, database_.MainPercent());
    };
    database_.OnResetProgress = [this](TMusicDatabase&) {
        if (window_) window_->Reset();
    };
    database_.OnEndProgress = [this](TMusicDatabase&) { RunEnded(); };
    database_.OnCaptionChanged = [this](TMusicDatabase&) { ShowCaption(); };
    ShowCaption();
}

ProgressDisplay::~ProgressDisplay() {
    database_.OnStartProgress = nullptr;
    database_.OnProgress = nullptr;
    database_.OnResetProgress = nullptr;
    database_.OnEndProgress = nullptr;
    database_.OnCaptionChanged = nullptr;
}

void ProgressDisplay::RunStarted() {
    if (!window_) {
        window_ = std::make_unique<TPrgForm>(&mainWindow_);
        window_->OnStop = [this] { database_.RequestAbort(); };
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
