#pragma once

#include <QString>

// The format text of a record for the file type of a "TFLT" frame ("MPG/3", "/3", "VQF"); a type that the
// table does not know is its own text.
QString FormatFromFileType(const QString& fileType);
// The opposite: what a "TFLT" frame says of a format text; a text without a row is written as it stands.
QString FileTypeFromFormat(const QString& format);
