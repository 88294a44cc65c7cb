#pragma once

#include <QtGlobal>
#include <optional>

#include "CommonRUKTools/FileSource.h"
#include "ReadMPEGHeader/ID3Tag.h"

// What the chunks of a RIFF file of the form "WAVE" tell.
struct WaveInfo {
    quint16 Channels = 0;
    quint32 SampleRate = 0;  // Hz
    quint32 ByteRate = 0;    // bytes per second
    quint16 BlockAlign = 0;  // bytes
    qint64 DataBytes = 0;    // bytes of sound that the file really holds
};

// Walks the chunks, which may stand in any order and lie about their sizes. Nothing when the file is not of
// the form "WAVE" or has no format chunk. Throws only when the medium fails.
std::optional<WaveInfo> ReadWaveHeader(ByteSource& stream);

// The technical data of a WAV file; values that do not fit a field are saturated.
TID3Tag TagFromWave(const WaveInfo& info, double fileTime);
