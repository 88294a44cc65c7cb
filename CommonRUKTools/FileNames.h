#pragma once

#include <QString>

// Makes a text the name of a file on every system: what Windows forbids ( \ / : * ? " < > | and control
// characters) is replaced, trailing dots and blanks go, a reserved device name gets an underscore in front.
// Never empty.
QString MakeValidFileName(const QString& text);
