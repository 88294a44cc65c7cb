#pragma once

#include <functional>

#include "MusicManagment/conversion/EncoderSettings.h"
#include "ReadMPEGHeader/SongReading.h"

// One file becomes another of another format.
struct ConversionJob {
    QString Source{};  // the file, where it is now
    QString Target{};
    MusicFormat Format = MusicFormat::Mp3;
    TID3Tag Record{};  // what the tags of the target say; cover and track total come from the source
    ReadProfile Profile = ReadProfile::Modern;  // by which tags are written and read
};

// Asked many times a second with the part that is done, 0 to 1; false: it is to stop.
using ConversionProgress = std::function<bool(double done)>;

// Makes the target, which must not be there, and takes away what was begun when it fails. Returns what is
// read from the new file. May run in several threads. Throws ERukException with the reason, EAbort when it
// was stopped.
TID3Tag ConvertSong(const ConversionJob& job, const EncoderSettings& settings,
                    const ConversionProgress& goOn);
