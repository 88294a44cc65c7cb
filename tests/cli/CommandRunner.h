#pragma once

#include <gtest/gtest.h>

#include <QJsonDocument>
#include <QJsonObject>
#include <cstdio>
#include <memory>

#include "cli/CommandLine.h"
#include "tests/database/SongFolder.h"

struct CloseFile {
    void operator()(std::FILE* file) const { std::fclose(file); }
};
using TemporaryStream = std::unique_ptr<std::FILE, CloseFile>;

inline QByteArray Contents(std::FILE* stream) {
    std::rewind(stream);
    QByteArray bytes;
    for (int c = std::fgetc(stream); c != EOF; c = std::fgetc(stream))
        bytes += static_cast<char>(c);
    return bytes;
}

struct CommandResult {
    int Status;
    QString Out;
    QString Err;

    std::vector<QJsonObject> Objects() const {
        std::vector<QJsonObject> objects;
        for (const QByteArray& line : Out.toUtf8().split('\n')) {
            if (line.isEmpty()) continue;
            QJsonParseError error;
            const auto document = QJsonDocument::fromJson(line, &error);
            EXPECT_EQ(error.error, QJsonParseError::NoError) << line.constData();
            objects.push_back(document.object());
        }
        return objects;
    }
};

inline CommandResult RunWords(const QStringList& words) {
    const TemporaryStream out(std::tmpfile());
    const TemporaryStream err(std::tmpfile());
    const int status = RunCommand(words, {out.get(), err.get()});
    return {status, QString::fromUtf8(Contents(out.get())), QString::fromUtf8(Contents(err.get()))};
}

// A test with a folder of its own and sound files in it.
class CommandTest : public testing::Test {
 protected:
    QString Path(const QString& name) const { return folder_.Path(name); }
    void Put(const QString& path, ByteSpan bytes) const {
        folder_.Put(QDir(folder_.Path()).relativeFilePath(path), bytes);
    }
    // Returns the path.
    QString PutWave(const QString& name, std::uint32_t seconds = 1) const {
        return folder_.Add(name, seconds);
    }

    SongFolder folder_;
};
