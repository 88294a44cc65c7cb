#pragma once

#include <QString>
#include <QStringView>

// Makes a text the name of a file on every system: what Windows forbids ( \ / : * ? " < > | and control
// characters) is replaced, trailing dots and blanks go, a reserved device name gets an underscore in front.
// Never empty.
QString MakeValidFileName(const QString& text);

// How long a name of a file may be, in the units of FileNameLength: bytes of UTF-8, on Windows characters of
// UTF-16.
inline constexpr qsizetype kLongestFileName = 255;
qsizetype FileNameLength(QStringView name);
// The beginning of a text, at most so long; what a reader sees as one character is not cut through.
QString CutToFileNameLength(const QString& text, qsizetype longest);
