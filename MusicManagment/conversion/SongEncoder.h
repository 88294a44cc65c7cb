#pragma once

#include <QString>
#include <cstddef>
#include <memory>

#include "MusicManagment/conversion/EncoderSettings.h"

// Writes one file of a format out of stereo samples. Failures are ERukExceptions for the user.
class SongEncoder {
 public:
    virtual ~SongEncoder() = default;
    virtual void Write(const float* stereo, std::size_t frames) = 0;
    // Nothing may be written afterwards. Without it the file is of no use.
    virtual void Finish() = 0;
};

// What the samples are like.
struct SampleKind {
    int Rate = 0;  // Hz
    bool IsMono = false;
    bool FitsIn16Bits = false;
};

// Makes the file, which must not be there.
std::unique_ptr<SongEncoder> MakeMp3Encoder(const QString& path, const Mp3Settings& settings,
                                            const SampleKind& samples);
std::unique_ptr<SongEncoder> MakeWaveEncoder(const QString& path, const WavSettings& settings,
                                             const SampleKind& samples);
