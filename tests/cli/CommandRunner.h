#pragma once

#include <gtest/gtest.h>

#include <QDir>
#include <QFile>
#include <QJsonDocument>
#include <QJsonObject>
#include <QTemporaryDir>
#include <cstdio>
#include <memory>

#include "CommonRUKTools/ByteWriter.h"
#include "cli/CommandLine.h"

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
    QString Path(const QString& name) const { return folder_.filePath(name); }

    static void Put(const QString& path, ByteSpan bytes) {
        QDir().mkpath(QFileInfo(path).path());
        QFile file(path);
        ASSERT_TRUE(file.open(QIODevice::WriteOnly));
        file.write(reinterpret_cast<const char*>(bytes.data()), static_cast<qsizetype>(bytes.size()));
    }

    // Mono, 8 bits, 8000 Hz. Returns the path.
    QString PutWave(const QString& name, std::uint32_t seconds = 1) const {
        const std::uint32_t size = 8000 * seconds;
        ByteWriter wave;
        wave.Raw("RIFF");
        wave.U32Le(36 + size);
        wave.Raw("WAVEfmt ");
        wave.U32Le(16);
        wave.U16Le(1);
        wave.U16Le(1);
        wave.U32Le(8000);
        wave.U32Le(8000);
        wave.U16Le(1);
        wave.U16Le(8);
        wave.Raw("data");
        wave.U32Le(size);
        wave.Zeros(size);
        Put(Path(name), wave.Bytes());
        return Path(name);
    }

    QTemporaryDir folder_;
};
