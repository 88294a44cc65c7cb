#pragma once

#include <QString>
#include <ostream>

// Lets a failing comparison show the text instead of its bytes. GoogleTest finds it by argument-dependent
// look-up.
inline void PrintTo(const QString& text, std::ostream* out) {
    *out << '"' << text.toStdString() << '"';
}
