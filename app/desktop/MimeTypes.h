#pragma once

#include <QString>
#include <span>

// What the program does with a file that it is given at its start.
enum class FileKind { Unknown, PlayList, Song, Database, Arrangement };

// One of the program's own file types, as the desktop gets to know it.
struct FileType {
    QStringView MimeType;
    QStringView Description;
    QStringView Extensions[3];  // with the dot, lower case; those behind the first may be empty
    FileKind Kind;
};

std::span<const FileType> OwnFileTypes();

// The end of the file's name from its last dot on, as it is written; empty without a dot.
QString FileExtension(const QString& path);
// By the extension, in capitals too.
FileKind KindOfFile(const QString& path);
