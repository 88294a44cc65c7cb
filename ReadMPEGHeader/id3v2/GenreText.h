#pragma once

#include <QString>
#include <QStringList>
#include <QtGlobal>
#include <optional>

#include "ReadMPEGHeader/id3v2/ID3v2FrameBody.h"

// What the text of a "TCON" frame says.
struct GenreText {
    std::optional<quint8> Genre{};  // nothing: the record's genre stays as it is
    bool Remix = false;
    quint8 MainGenre = 0;  // what number or text belong to, a text that names a main genre first
};

// Classic rules: only a number in parentheses at the start of the first value counts: "(17)", "(17)German
// Rock (RX)". Otherwise also "17", "(51)(39)", "(17)Rock", a name of the table in any case and the mark "RX";
// the first value that names a genre of the table counts, and the main genre is looked for.
GenreText ParseGenre(TextRules rules, const QStringList& values);
