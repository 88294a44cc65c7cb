#include "cli/TransientLine.h"

#include "cli/Console.h"

using namespace Qt::StringLiterals;

namespace {

constexpr qsizetype kLineWidth = 78;

}  // namespace

void TransientLine::Show(const QString& text) {
    if (IsWatched()) Print(Printable(text).left(kLineWidth));
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
