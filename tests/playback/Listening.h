#pragma once

#include <gtest/gtest.h>

#include <QTemporaryDir>

#include "MusicManagment/playback/fmod/SinkOutput.h"
#include "MusicManagment/playback/fmod/SoundLibrary.h"
#include "tests/playback/SoundFiles.h"

// A sound library whose mix a test pulls and keeps, and a folder for its files.
class Listening : public testing::Test {
 protected:
    static constexpr int kRate = 44100;

    void Init(int softChannels = 32) {
        library.FSOUND_SetOutput(FSOUND_OUTPUT_NOSOUND);
        ASSERT_TRUE(library.FSOUND_Init(kRate, softChannels, 2));
    }
    QString Path(const char* name) const { return folder.filePath(QString::fromUtf8(name)); }
    static std::size_t Frames(double seconds) { return static_cast<std::size_t>(seconds * kRate + 0.5); }
    std::size_t HeardFrames() const { return heard->size() / 2; }
    void Hear(double seconds) { library.Advance(Frames(seconds)); }

    FSOUND_STREAM OpenStream(const QString& path, unsigned mode = 0x20029) {
        return library.FSOUND_Stream_OpenFile(path, mode);
    }
    int Play(FSOUND_STREAM stream) {
        return library.FSOUND_Stream_PlayEx(stream, FSOUND_FREE, FSOUND_DSPUNIT::kNone, false);
    }
    // Opens and plays a file to its end. Everything that is heard, up to the block in which it ends.
    Samples HearAll(const QString& path) {
        heard->clear();
        const FSOUND_STREAM stream = OpenStream(path);
        const int channel = Play(stream);
        for (int i = 0; library.FSOUND_IsPlaying(channel) && i < 10'000; ++i)
            library.Advance(1024);
        library.FSOUND_Stream_Close(stream);
        return *heard;
    }

    QTemporaryDir folder;
    std::shared_ptr<CaptureOutput::Samples> heard = std::make_shared<CaptureOutput::Samples>();
    SoundLibrary library{[this](TFSoundOutputTypes) { return std::make_unique<CaptureOutput>(heard); }};
};

// The largest difference between two pieces of sound.
inline double Difference(const Samples& a, std::size_t fromA, const Samples& b, std::size_t fromB,
                         std::size_t frames) {
    double most = 0;
    for (std::size_t i = 0; i < 2 * frames; ++i)
        most = std::max(most, std::abs(static_cast<double>(a.at(2 * fromA + i)) - b.at(2 * fromB + i)));
    return most;
}
