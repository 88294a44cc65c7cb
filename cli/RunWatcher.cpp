#include "cli/RunWatcher.h"

#include "CommonRUKTools/Clock.h"
#include "cli/platform/Terminal.h"

using namespace Qt::StringLiterals;

namespace {

constexpr qint64 kShowEveryMs = 100;
constexpr qsizetype kLineWidth = 78;

// What the run is called, without the name of the component.
QString RunName(const TMusicDatabase& database) {
    const QString& caption = database.Caption();
    return caption.mid(caption.indexOf(u" - "_s) + 3);
}

}  // namespace

RunWatcher::RunWatcher(TMusicDatabase& database, Console& console, StopBy stopBy)
    : database_(database),
      terminal_(IsTerminal(console.ErrorStream()) ? console.ErrorStream() : nullptr),
      nextShow_(CurrentClock().Ticks() + kShowEveryMs) {
    database_.OnProgress = [this, stopBy](TMusicDatabase&, const ProgressPoint& point) {
        if (stopBy == StopBy::Interrupt && InterruptRequested()) database_.RequestAbort();
        if (terminal_ != nullptr) Show(point);
    };
    database_.OnEndProgress = [this](TMusicDatabase&) { Erase(); };
}

RunWatcher::~RunWatcher() {
    database_.OnProgress = nullptr;
    database_.OnEndProgress = nullptr;
    Erase();
}

void RunWatcher::Show(const ProgressPoint& point) {
    const qint64 now = CurrentClock().Ticks();
    if (now < nextShow_) return;
    nextShow_ = now + kShowEveryMs;
    const int percent = database_.MainPercent();
    QString text = RunName(database_);
    if (percent >= 0) text += u": "_s + QString::number(percent) + u" %"_s;
    if (!point.Description.isEmpty()) text += u"  "_s + point.Description;
    Print(Printable(text).left(kLineWidth));
}

void RunWatcher::Print(const QString& text) {
    const QString line = u'\r' + text.leftJustified(shown_);
    std::fputs(line.toUtf8().constData(), terminal_);
    std::fflush(terminal_);
    shown_ = text.size();
}

void RunWatcher::Erase() {
    if (shown_ == 0) return;
    Print(QString());
    std::fputc('\r', terminal_);
    std::fflush(terminal_);
}
