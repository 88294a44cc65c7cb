#pragma once

#include <QByteArrayView>
#include <QString>
#include <cstdio>

#include "CommonRUKTools/Errors.h"

// Nobody reads the output any more (a pipe into "head"). No failure: the reader has what it wanted.
class EOutputClosed : public ERukException {
 public:
    EOutputClosed() : ERukException(QString()) {}
};

// The two streams of a command: data go out, messages and progress go to the error stream.
class Console {
 public:
    // The caller keeps ownership of both.
    Console(std::FILE* out, std::FILE* err) : out_(out), err_(err) {}

    // Each throws EOutputClosed, or EStreamError when the output cannot be written (disk full).
    void Write(QByteArrayView bytes);
    void WriteLine(const QString& text);
    void Flush();

    // A line on the error stream.
    void Message(const QString& text);
    std::FILE* ErrorStream() const { return err_; }

 private:
    std::FILE* out_;
    std::FILE* err_;
};

// A text from a song without what could steer a terminal or break a line in two: control characters become
// blanks.
QString Printable(QString text);
