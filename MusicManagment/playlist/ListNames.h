#pragma once

#include <QByteArray>
#include <QString>
#include <optional>

#include "CommonRUKTools/ByteReader.h"

// What the playlists made of text have in common: lines, and how a song is named in them.

// Gives one line after another, cut at CR or LF; empty ones are left out. A hostile file has more of them
// than there is memory for a list of them.
class LineReader {
 public:
    explicit LineReader(ByteSpan bytes) : rest_(bytes) {}
    // Nothing at the end.
    std::optional<ByteSpan> Next();

 private:
    ByteSpan rest_;
};

// The path of a file: address on this computer (RFC 8089); empty for anything else.
QString LocalPath(const QString& address);

// "http://..." and its like.
bool IsAddress(const QString& text);

// The name of the entry that a text stands for. A relative name is made absolute against `folder`, a file:
// address becomes a path. Left as they are: other addresses (http), paths with a drive letter, paths
// on catalogued CDs, and names of one character.
QString NameFromList(const QString& text, const QString& folder);
QString NameFromList(ByteSpan text, const QString& folder);

// How a list's texts become bytes: CodePage::ToSystem, or ToUtf8.
using ListEncoder = QByteArray (*)(QStringView text);
QByteArray ToUtf8(QStringView text);

// The line for a name: a file: address where a path from "/" would not read back, because it has line ends in
// it or blanks at an end. Of other names blanks are kept, which PLS lists put into quotes.
QByteArray PathForList(const QString& name, ListEncoder encode);
// "artist - title" on one line.
QByteArray TitleForList(const QString& artist, const QString& title, ListEncoder encode);
