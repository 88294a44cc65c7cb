#pragma once

#include <QImage>
#include <QString>
#include <vector>

#include "ReadMPEGHeader/SongReading.h"
#include "app/models/SongProperties.h"

// What only a look at the song's file tells.
struct FileDetails {
    std::vector<PropertyRow> File{};    // size and time of the last change
    std::vector<PropertyRow> Frames{};  // of the ID3v2 tag: id and text
    QImage Cover{};                     // reduced; null when the file has none that can be shown
    QString Error{};                    // why the file could not be read; empty when it could
};

// Reads the file; errors are part of the result. `options` say how, their OnFrame is replaced.
FileDetails ReadFileDetails(const QString& path, ReadOptions options);
