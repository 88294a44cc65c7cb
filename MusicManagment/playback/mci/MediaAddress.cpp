#include "MusicManagment/playback/mci/MediaAddress.h"

#include <QFile>
#include <QUrl>

#include "MusicManagment/playback/fmod/MidiFile.h"

namespace {

constexpr qint64 kHeadBytes = 44;  // a whole .cda file
constexpr std::size_t kTrackNumber = 22;
// A MIDI file grows in the address and in the player to a multiple of itself.
constexpr qint64 kMostMidiBytes = 4 << 20;

ByteSpan Bytes(const QByteArray& bytes) {
    return {reinterpret_cast<const std::uint8_t*>(bytes.constData()), static_cast<std::size_t>(bytes.size())};
}

QByteArray MidiAddress(const QByteArray& file) {
    const ByteSpan midi = WithoutWrapper(Bytes(file));
    return "data:audio/midi;base64," +
           QByteArray(reinterpret_cast<const char*>(midi.data()), static_cast<qsizetype>(midi.size()))
               .toBase64();
}

QByteArray TrackAddress(ByteSpan head) {
    ByteReader reader(head);
    reader.Seek(kTrackNumber);
    return "cdda://" + QByteArray::number(reader.U16Le());
}

bool IsTrackOfDisc(ByteSpan head) {
    return StartsWith(head, "RIFF") && head.size() == kHeadBytes && StartsWith(head.subspan(8), "CDDA");
}

}  // namespace

QByteArray MediaAddress(const QString& path) {
    QFile file(path);
    // One that cannot be read is refused by the player, which knows why.
    const QByteArray head = file.open(QIODevice::ReadOnly) ? file.peek(kHeadBytes) : QByteArray();
    if (IsTrackOfDisc(Bytes(head))) return TrackAddress(Bytes(head));
    if (head.startsWith("RIFF") && LooksLikeMidi(Bytes(head)) && file.size() <= kMostMidiBytes)
        return MidiAddress(file.readAll());
    return QUrl::fromLocalFile(path).toEncoded();
}
