#include "MusicManagment/playback/fmod/SongFile.h"

#include <QFile>

#include "MusicManagment/playback/fmod/MidiFile.h"
#include "MusicManagment/playback/fmod/MidiSource.h"
#include "MusicManagment/playback/fmod/ModuleSource.h"

namespace {

constexpr qint64 kHeadBytes = 2048;
// Songs are kept in memory, and a MIDI file grows there to a multiple of itself.
constexpr qint64 kMostModuleBytes = 64 << 20;
constexpr qint64 kMostMidiBytes = 4 << 20;

ByteSpan Bytes(const QByteArray& bytes) {
    return {reinterpret_cast<const std::uint8_t*>(bytes.constData()), static_cast<std::size_t>(bytes.size())};
}

}  // namespace

std::unique_ptr<SongSource> LoadSongFile(const QString& path, int rate, const QString& midiFont) {
    QFile file(path);
    if (!file.exists()) throw ESoundFileError(FMOD_ERR_FILE_NOTFOUND);
    if (!file.open(QIODevice::ReadOnly)) throw ESoundFileError(FMOD_ERR_FILE_BAD);
    const QByteArray head = file.peek(kHeadBytes);
    const bool midi = LooksLikeMidi(Bytes(head));
    if ((!midi && !ModuleSource::Probe(Bytes(head), static_cast<std::uint64_t>(file.size()))) ||
        file.size() > (midi ? kMostMidiBytes : kMostModuleBytes))
        throw ESoundFileError(FMOD_ERR_FILE_FORMAT);
    const QByteArray bytes = file.readAll();
    return midi ? LoadMidiSong(bytes, rate, midiFont) : ModuleSource::Load(Bytes(bytes), rate);
}
