#include "cli/RunWatcher.h"

#include "CommonRUKTools/Clock.h"
#include "cli/platform/Terminal.h"

using namespace Qt::StringLiterals;

namespace {

constexpr qint64 kShowEveryMs = 100;

// What the run is called, without the name of the component.
QString RunName(const TMusicDatabase& database) {
    const QString& caption = database.Caption();
    return caption.mid(caption.indexOf(u" - "_s) + 3);
}

}  // namespace

RunWatcher::RunWatcher(TMusicDatabase& database, Console& console, StopBy stopBy)
    : database_(database),
      line_(IsTerminal(console.ErrorStream()) ? console.ErrorStream() : nullptr),
      nextShow_(CurrentClock().Ticks() + kShowEveryMs) {
    database_.OnProgress = [this, stopBy](TMusicDatabase&, const ProgressPoint& point) {
        if (stopBy == StopBy::Interrupt && InterruptRequested()) database_.RequestAbort();
        if (line_.IsWatched()) Show(point);
    };
    database_.OnEndProgress = [this](TMusicDatabase&) { line_.Erase(); };
}

RunWatcher::~RunWatcher() {
    database_.OnProgress = nullptr;
    database_.OnEndProgress = nullptr;
}

void RunWatcher::Show(const ProgressPoint& point) {
    const qint64 now = CurrentClock().Ticks();
    if (now < nextShow_) return;
    nextShow_ = now + kShowEveryMs;
    const int percent = database_.MainPercent();
    QString text = RunName(database_);
    if (percent >= 0) text += u": "_s + QString::number(percent) + u" %"_s;
    if (!point.Description.isEmpty()) text += u"  "_s + point.Description;
    line_.Show(text);
}
