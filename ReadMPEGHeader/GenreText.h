#pragma once

#include <QString>
#include <QStringList>
#include <QtGlobal>
#include <optional>

// What the text of a "TCON" frame says.
struct GenreText {
    std::optional<quint8> Genre{};  // nothing: the record's genre stays as it is
    bool Remix = false;
};

// Only a number in parentheses at the start counts: "(17)", "(17)German Rock (RX)".
GenreText ParseGenreClassic(const QString& text);

// "17", "(17)", "(17)Rock", "(51)(39)", a name of the table in any case, the mark "(RX)" or "RX"; the first
// value that names a genre of the table counts.
GenreText ParseGenreValues(const QStringList& values);
