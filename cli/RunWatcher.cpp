#include "cli/RunWatcher.h"

#include "CommonRUKTools/Clock.h"
#include "cli/platform/Terminal.h"

using namespace Qt::StringLiterals;

namespace {

constexpr qint64 kShowEveryMs = 100;

}  // namespace

RunWatcher::RunWatcher(TMusicDatabase& database, Console& console, StopBy stopBy)
    : database_(database),
      line_(IsTerminal(console.ErrorStream()) ? console.ErrorStream() : nullptr),
      nextShow_(CurrentClock().Ticks() + kShowEveryMs) {
    Operation& operation = database_.CurrentOperation();
    watched_ += operation.Advanced.Subscribe([this, stopBy, &operation](const ProgressPoint& point) {
        if (stopBy == StopBy::Interrupt && InterruptRequested()) operation.RequestStop();
        if (line_.IsWatched()) Show(point);
    });
    watched_ += operation.Ended.Subscribe([this] { line_.Erase(); });
}

void RunWatcher::Show(const ProgressPoint& point) {
    const qint64 now = CurrentClock().Ticks();
    if (now < nextShow_) return;
    nextShow_ = now + kShowEveryMs;
    const int percent = database_.MainPercent();
    QString text = database_.CurrentOperation().Title().value_or(QString());
    if (percent >= 0) text += u": "_s + QString::number(percent) + u" %"_s;
    if (!point.Description.isEmpty()) text += u"  "_s + point.Description;
    line_.Show(text);
}
