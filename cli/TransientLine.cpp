#include "cli/TransientLine.h"

#include <algorithm>

#include "cli/Console.h"
#include "cli/platform/Terminal.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kUsualColumns = 80;

// A full line would move the cursor to the next, and what is written over it would stand below it.
int LineWidth(std::FILE* terminal) {
    const int columns = TerminalColumns(terminal);
    return std::max(columns > 0 ? columns : kUsualColumns, 2) - 1;
}

}  // namespace

void TransientLine::Show(const QString& text) {
    if (IsWatched()) Print(Printable(text).left(LineWidth(terminal_)));
}

void TransientLine::Erase() {
    if (shown_ == 0) return;
    Print(QString());
    std::fputc('\r', terminal_);
    std::fflush(terminal_);
}

void TransientLine::Print(const QString& text) {
    const QString line = u'\r' + text.leftJustified(shown_);
    std::fputs(line.toUtf8().constData(), terminal_);
    std::fflush(terminal_);
    shown_ = text.size();
}
