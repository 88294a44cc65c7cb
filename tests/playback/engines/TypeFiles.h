#pragma once

#include <QString>
#include <vector>

// A small song of each type that the engines' tables name.
struct FileType {
    const char* extension;
    void (*Write)(const QString& path);
    quint32 length;      // ms
    quint32 tolerance;   // ms, of the length: encoders put silence around a sound
    quint32 rowsLength;  // ms between the places that a seek in a song of rows can reach; 0 = it has none
};

const std::vector<FileType>& FileTypes();
const FileType& FileTypeOf(const QString& extension);
