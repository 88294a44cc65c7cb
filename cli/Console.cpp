#include "cli/Console.h"

#include <algorithm>
#include <cerrno>

#include "CommonRUKTools/SystemError.h"

using namespace Qt::StringLiterals;

namespace {

[[noreturn]] void ThrowWriteError(int error) {
    if (error == EPIPE) throw EOutputClosed();
    throw EStreamError(u"Die Ausgabe konnte nicht geschrieben werden: "_s + SystemErrorText(error));
}

}  // namespace

void Console::Write(QByteArrayView bytes) {
    const auto size = static_cast<std::size_t>(bytes.size());
    if (std::fwrite(bytes.data(), 1, size, out_) != size) ThrowWriteError(errno);
}

void Console::WriteLine(const QString& text) {
    Write(text.toUtf8() + '\n');
}

void Console::Flush() {
    if (std::fflush(out_) != 0) ThrowWriteError(errno);
}

void Console::Message(const QString& text) {
    // A message that cannot be shown has nowhere else to go.
    std::fprintf(err_, "%s\n", text.toUtf8().constData());
}

QString Printable(QString text) {
    const auto isControl = [](QChar c) {
        return c < u' ' || (c >= QChar(0x7F) && c < QChar(0xA0)) || c == QChar(QChar::LineSeparator) ||
               c == QChar(QChar::ParagraphSeparator);
    };
    if (std::any_of(text.cbegin(), text.cend(), isControl))
        std::replace_if(text.begin(), text.end(), isControl, QChar(u' '));
    return text;
}
