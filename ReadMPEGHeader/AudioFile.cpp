#include "ReadMPEGHeader/AudioFile.h"

#include "CommonRUKTools/Errors.h"

namespace {

SongReading& LastReading() {
    static SongReading reading;
    return reading;
}

}  // namespace

QString ReadAudioFile(const QString& path, const ReadOptions& options, TID3Tag& tag) {
    SongReading& reading = LastReading();
    reading = ReadSong(path, options);
    tag = reading.Tag;
    if (!reading.Error.isEmpty()) throw EStreamError(reading.Error);
    return reading.Refusal;
}

const MpegResults& LastMpegResults() {
    return LastReading().Mpeg;
}

const TDebugData& LastDebugData() {
    return LastReading().Remarks;
}
