#include "tests/playback/engines/TypeFiles.h"

#include <algorithm>
#include <stdexcept>

#include "tests/playback/SongFiles.h"
#include "tests/playback/SoundFiles.h"

namespace {

constexpr quint32 kLength = 2000;

// The FMOD back end counts 144 ms a row.
constexpr quint32 kPattern = 64 * 144;
constexpr quint32 kMidiRow = 144;

void WriteTone(const QString& path) {
    WriteSound(path, Sine({}, kLength / 1000));
}

QByteArray Tune() {
    MidiTrack track;
    for (const int key : {60, 64, 67, 72})
        track.Note(0, key, 480);
    return Midi({track.End(0)});
}

void WriteMidi(const QString& path) {
    WriteBytes(path, path.endsWith(QLatin1StringView("rmi")) ? Rmi(Tune()) : Tune());
}

template <QByteArray (*Make)(const ModuleSong&)>
void WriteModule(const QString& path) {
    WriteBytes(path, Make({}));
}

}  // namespace

const std::vector<FileType>& FileTypes() {
    static const std::vector<FileType> types = {
        {"mp3", WriteTone, kLength, 60, 0},
        {"mp2", WriteTone, kLength, 60, 0},
        {"wma", WriteTone, kLength, 120, 0},
        {"asf", WriteTone, kLength, 120, 0},
        {"ogg", WriteTone, kLength, 60, 0},
        {"wav", WriteTone, kLength, 1, 0},
        {"raw", WriteTone, kLength, 1, 0},
        {"avi", WriteTone, kLength, 20, 0},
        {"mid", WriteMidi, kLength, kMidiRow, kMidiRow},
        {"rmi", WriteMidi, kLength, kMidiRow, kMidiRow},
        {"mod", WriteModule<Mod>, 3 * kPattern, 0, kPattern},
        {"s3m", WriteModule<S3m>, 3 * kPattern, 0, kPattern},
        {"xm", WriteModule<Xm>, 3 * kPattern, 0, kPattern},
        {"it", WriteModule<It>, 3 * kPattern, 0, kPattern},
    };
    return types;
}

const FileType& FileTypeOf(const QString& extension) {
    const auto found = std::ranges::find_if(
        FileTypes(), [&](const FileType& type) { return extension == QLatin1StringView(type.extension); });
    if (found == FileTypes().end()) throw std::runtime_error("no such type: " + extension.toStdString());
    return *found;
}
