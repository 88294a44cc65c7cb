#pragma once

#include <QString>
#include <functional>
#include <memory>
#include <optional>

#include "MusicManagment/playback/fmod/AudioOutput.h"
#include "MusicManagment/playback/fmod/FmodLibrary.h"

// Which output the mix goes to, when it is not the one that the output type asks for.
struct OutputChoice {
    enum class Kind {
        ByType,   // as FSOUND_SetOutput says
        Null,     // silence that keeps time
        WavFile,  // `name` is the file
        Sdl,      // `name` is one of SDL's drivers
    };
    Kind kind = Kind::ByType;
    QString name{};
    bool floats = false;   // WavFile: 32-bit floats instead of 16-bit integers
    bool unpaced = false;  // WavFile, Null: as fast as Advance is called instead of in real time
};

// Reads "null", "file:FILE" or "capture:FILE" and "sdl:NAME"; nothing for any other text.
std::optional<OutputChoice> ParseOutputChoice(const QString& text);

// Makes the output for an output type; nullptr when there is none.
using OutputFactory = std::function<std::unique_ptr<AudioOutput>(TFSoundOutputTypes)>;

OutputFactory OutputsFor(const OutputChoice& choice);
// What TUNESTEAD_AUDIO in the environment asks for, by type when it is not set. A value that cannot be read
// leads to no output at all, so that a mistake is not taken for silence.
OutputFactory OutputsOfEnvironment();
