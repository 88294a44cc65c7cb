#pragma once

#include <QByteArrayView>
#include <QStringList>
#include <string_view>
#include <vector>

#include "ReadMPEGHeader/ID3Tag.h"

// Builds JSON objects (RFC 8259), one a line. Keys are ASCII. The buffer is kept from line to line, so that a
// million of them cost no allocation each.
class JsonLine {
 public:
    void Begin();
    // The finished line with its end; valid until the next Begin().
    QByteArrayView End();

    void Text(std::string_view key, QStringView value);
    void Texts(std::string_view key, const QStringList& values);
    void Number(std::string_view key, qint64 value);
    // The shortest form that reads back as the same number; null for what JSON cannot hold.
    void Real(std::string_view key, double value);
    void Flag(std::string_view key, bool value);
    void Null(std::string_view key);

    void BeginArray(std::string_view key);
    void EndArray();
    void BeginItem();
    void EndItem();

 private:
    char* Room(std::size_t size);
    void Put(std::string_view text);
    void PutKey(std::string_view key);
    void PutQuoted(QStringView text);
    template <typename T>
    void PutNumber(T value);
    void Separate();
    void Close(char bracket);

    std::vector<char> line_;
    std::size_t used_ = 0;  // bytes of `line_` that are written
    bool first_ = true;
};

// The fields of a record, as the commands that show songs have in common.
void WriteSongFields(JsonLine& line, const TID3Tag& song);
