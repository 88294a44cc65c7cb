#pragma once

#include <gtest/gtest.h>

#include "CommonRUKTools/WriteGate.h"
#include "MusicManagment/conversion/ConversionRun.h"
#include "MusicManagment/conversion/SongDecoder.h"
#include "tests/ErrorOf.h"
#include "tests/PrintQt.h"
#include "tests/database/SongFolder.h"
#include "tests/playback/SoundFiles.h"

// Nothing here is to survive the machine, so the disk is not waited for.
class HastyGate : public WriteGate {
 public:
    HastyGate() { SetWriteGate(this); }
    ~HastyGate() override { SetWriteGate(nullptr); }
    int Before(DiskStep, const QString&) override { return 0; }
    bool WaitsForDisk() const override { return false; }
};

// A folder with sounds to convert, and what is heard of the results.
class ConversionRig : public testing::Test {
 protected:
    ConversionRig() { settings_.Script = QStringLiteral(TUNESTEAD_WMA_SCRIPT); }

    static Samples Decoded(const QString& path, int rate = 0) {
        const DecodedSong song = OpenDecodedSong(path, [rate](int own) { return rate != 0 ? rate : own; });
        constexpr std::size_t kBlock = 4096;
        Samples all;
        for (std::size_t frames = kBlock; frames == kBlock;) {
            const std::size_t before = all.size();
            all.resize(before + 2 * kBlock);
            frames = song.Source->Read(all.data() + before, kBlock);
            all.resize(before + 2 * frames);
        }
        return all;
    }
    QString Sound(const QString& name, double seconds = 0.4) const {
        WriteSound(folder_.Path(name), Sine({}, seconds));
        return folder_.Path(name);
    }
    // A program that does what the lines say; $1 is the source, $2 the target, $3 the bit rate.
    QString Script(const QByteArray& lines) const {
        const QString path = folder_.Put(QStringLiteral("skript"), "#!/bin/sh\n" + lines);
        QFile::setPermissions(path, QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);
        return path;
    }
    ConversionJob Job(const QString& name, MusicFormat format) const {
        const QString source = folder_.Path(name);
        ConversionJob job{.Source = source, .Target = source + ExtensionOf(format), .Format = format};
        job.Record.Title = QStringLiteral("Titel");
        return job;
    }
    TID3Tag Convert(const ConversionJob& job) const {
        return ConvertSong(job, settings_, [](double) { return true; });
    }
    QStringList Files() const {
        return QDir(folder_.Path()).entryList(QDir::Files | QDir::Hidden, QDir::Name);
    }

    HastyGate gate_;
    SongFolder folder_;
    EncoderSettings settings_;
};
