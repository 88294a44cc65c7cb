#pragma once

#include <QString>
#include <functional>
#include <memory>

#include "MusicManagment/playback/fmod/SoundSource.h"

class FFmpegFile;

// A song as the stereo samples that it is converted from.
struct DecodedSong {
    std::unique_ptr<SoundSource> Source{};
    const FFmpegFile* File = nullptr;  // that the source reads, where it is a sound file
    int Rate = 0;                      // Hz
    bool IsMono = false;               // both sides are the same
    bool FitsIn16Bits = false;         // samples of 16 bits hold them as they are
};

// Opens everything that the player decodes itself: sound files, tracker songs and MIDI. `rateFor` gets the
// rate of the file, which for songs that are played by notes is 44100, and says at which it is to be decoded.
// Throws ESoundFileError.
DecodedSong OpenDecodedSong(const QString& path, const std::function<int(int ownRate)>& rateFor);

// The length of a sound file in samples a channel at its own rate, by all its packets. Throws
// ESoundFileError.
struct SoundLength {
    std::int64_t Samples = 0;
    int Rate = 0;  // Hz
};
SoundLength MeasureSound(const QString& path);

// Why a file cannot be decoded, in words for the user: those of the error itself are the sound library's.
QString ReasonOf(const ESoundFileError& error);
