#pragma once

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QTemporaryDir>
#include <filesystem>

#include "tests/WaveFile.h"

// A temporary folder for a test, with small WAV files whose names tell artist and title
// ("Queen - Jealousy.wav") and whatever else it puts there.
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
    // Each makes the folders that are missing, and returns the path.
    QString Put(const QString& name, const QByteArray& bytes) const {
        QDir().mkpath(QFileInfo(Path(name)).path());
        QFile file(Path(name));
        if (!file.open(QIODevice::WriteOnly) || file.write(bytes) != bytes.size())
            qFatal("cannot write %s", qPrintable(Path(name)));
        return Path(name);
    }
    QString Put(const QString& name, ByteSpan bytes) const {
        return Put(name, QByteArray(reinterpret_cast<const char*>(bytes.data()),
                                    static_cast<qsizetype>(bytes.size())));
    }
    QString Add(const QString& name, std::uint32_t seconds = 0) const { return Put(name, Wave(seconds)); }
    QStringList Add(const QStringList& names) const {
        for (const QString& name : names)
            Add(name);
        return Paths(names);
    }

    // What a file holds; "unreadable" where there is none.
    QByteArray Get(const QString& name) const {
        QFile file(Path(name));
        return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray("unreadable");
    }

 private:
    // One channel of 8 bits, 1000 samples a second.
    static QByteArray Wave(std::uint32_t seconds) {
        constexpr std::uint32_t kRate = 1000;
        ByteWriter file = WaveHead({.Rate = kRate, .Channels = 1, .Bits = 8}, seconds * kRate);
        file.Zeros(seconds * kRate);
        const auto& bytes = file.Bytes();
        return {reinterpret_cast<const char*>(bytes.data()), static_cast<qsizetype>(bytes.size())};
    }

    QTemporaryDir folder_;
};
