#pragma once

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QTemporaryDir>
#include <filesystem>

#include "CommonRUKTools/ByteWriter.h"

// A temporary folder of small WAV files, whose names tell artist and title: "Queen - Jealousy.wav".
class SongFolder {
 public:
    SongFolder() { folder_.setAutoRemove(false); }
    ~SongFolder() {
        // Qt would leave behind what it has no name for, and paths that are too long.
        std::error_code ignored;
        std::filesystem::remove_all(folder_.path().toStdU16String(), ignored);
    }
    SongFolder(const SongFolder&) = delete;
    SongFolder& operator=(const SongFolder&) = delete;

    QString Path(const QString& name = {}) const {
        const QString root = QFileInfo(folder_.path()).canonicalFilePath();
        return name.isEmpty() ? root : root + u'/' + name;
    }
    QStringList Paths(const QStringList& names) const {
        QStringList paths;
        for (const QString& name : names)
            paths << Path(name);
        return paths;
    }
    // Makes the folders that are missing, and returns the path.
    QString Add(const QString& name, std::uint32_t seconds = 0) const {
        QDir().mkpath(QFileInfo(Path(name)).path());
        QFile file(Path(name));
        const auto bytes = Wave(seconds);
        if (!file.open(QIODevice::WriteOnly) ||
            file.write(reinterpret_cast<const char*>(bytes.data()), static_cast<qint64>(bytes.size())) < 44)
            qFatal("cannot write %s", qPrintable(Path(name)));
        return Path(name);
    }
    QStringList Add(const QStringList& names) const {
        for (const QString& name : names)
            Add(name);
        return Paths(names);
    }

 private:
    // One channel of 8 bits, 1000 samples a second.
    static std::vector<std::uint8_t> Wave(std::uint32_t seconds) {
        constexpr std::uint32_t kRate = 1000;
        ByteWriter file;
        file.Raw("RIFF");
        file.U32Le(36 + seconds * kRate);
        file.Raw("WAVEfmt ");
        file.U32Le(16);
        file.U16Le(1);
        file.U16Le(1);
        file.U32Le(kRate);
        file.U32Le(kRate);
        file.U16Le(1);
        file.U16Le(8);
        file.Raw("data");
        file.U32Le(seconds * kRate);
        file.Zeros(seconds * kRate);
        return {file.Bytes().begin(), file.Bytes().end()};
    }

    QTemporaryDir folder_;
};
