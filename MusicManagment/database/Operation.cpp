#include "MusicManagment/database/Operation.h"

#include <QCoreApplication>

#include "CommonRUKTools/Dialogs.h"
#include "CommonRUKTools/Errors.h"

using namespace Qt::StringLiterals;

namespace {

void MakeKnown(qint64& current, qint64& maximum) {
    if (maximum != -1) return;
    maximum = current == -1 ? 0 : 100;
    if (current == -1) current = 0;
}

int Percent(qint64 current, qint64 maximum) {
    return maximum > 0 ? static_cast<int>(100.0 / static_cast<double>(maximum) * static_cast<double>(current))
                       : -1;
}

}  // namespace

void Operation::Start(const QString& title, Commands commands) {
    if (running_) {
        UserDialogs().ShowMessage(
            MessageKind::Warning,
            u"Warten Sie, bis der gerade laufende Vorgang beendet wurde oder brechen Sie ihn ab."_s);
        throw EAbort();
    }
    ResetPoint();
    title_ = title;
    Starting.Tell();
    TitleChanged.Tell();
    running_ = true;
    stopRequested_ = false;
    if (commands == Commands::Rest) commandsRest_ = true;
    Started.Tell();
}

bool Operation::Reach(const ProgressPoint& point, Point told) {
    lastPoint_ = point;
    if (told == Point::Told) Tell();
    if (letsInterfaceWork_ && QCoreApplication::instance() != nullptr) QCoreApplication::processEvents();
    return stopRequested_;
}

void Operation::Tell() {
    MakeKnown(lastPoint_.Cur, lastPoint_.Max);
    MakeKnown(lastPoint_.CurSub, lastPoint_.MaxSub);
    mainPercent_ = Percent(lastPoint_.Cur, lastPoint_.Max);
    subPercent_ = Percent(lastPoint_.CurSub, lastPoint_.MaxSub);
    Advanced.Tell(lastPoint_);
}

void Operation::End(Commands commands) {
    if (commands == Commands::Stay) commandsRest_ = false;
    running_ = false;
    stopRequested_ = false;
    title_.reset();
    TitleChanged.Tell();
    Ending.Tell();
    ResetPoint();
    Ended.Tell();
}

void Operation::ResetPoint() {
    lastPoint_ = ProgressPoint();
    mainPercent_ = -1;
    subPercent_ = -1;
    Reset.Tell();
}
