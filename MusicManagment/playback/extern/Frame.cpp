#include "MusicManagment/playback/extern/Frame.h"

#include <QtEndian>

#include "CommonRUKTools/ByteReader.h"

namespace {

// Length of what follows, kind, id, code, number; then the text. Little-endian.
constexpr qsizetype kLengthSize = 4;
constexpr qsizetype kHeadSize = 1 + 4 + 4 + 8;

template <typename T>
void Append(QByteArray& bytes, T value) {
    const T little = qToLittleEndian(value);
    bytes.append(reinterpret_cast<const char*>(&little), sizeof(little));
}

// A cut never splits a character.
QByteArray Shortened(const QString& text) {
    QByteArray bytes = text.toUtf8();
    if (bytes.size() <= kLongestText) return bytes;
    qsizetype end = kLongestText;
    while (end > 0 && (static_cast<quint8>(bytes.at(end)) & 0xC0U) == 0x80U)
        --end;
    return bytes.first(end);
}

ByteSpan AsSpan(const QByteArray& bytes) {
    return {reinterpret_cast<const std::uint8_t*>(bytes.constData()), static_cast<std::size_t>(bytes.size())};
}

}  // namespace

QByteArray Encode(const Frame& frame) {
    const QByteArray text = Shortened(frame.Text);
    QByteArray bytes;
    Append(bytes, static_cast<quint32>(kHeadSize + text.size()));
    Append(bytes, static_cast<quint8>(frame.Kind));
    Append(bytes, frame.Id);
    Append(bytes, frame.Code);
    Append(bytes, frame.Number);
    return bytes + text;
}

void FrameReader::Append(const QByteArray& bytes) {
    if (!broken_) bytes_ += bytes;
}

std::optional<Frame> FrameReader::Next() {
    if (broken_ || bytes_.size() < kLengthSize) return std::nullopt;
    ByteReader reader(AsSpan(bytes_));
    const auto length = static_cast<qsizetype>(reader.U32Le());
    broken_ = length < kHeadSize || length > kHeadSize + kLongestText;
    if (broken_ || bytes_.size() < kLengthSize + length) return std::nullopt;

    Frame frame;
    const quint8 kind = reader.U8();
    frame.Kind = static_cast<FrameKind>(kind);
    frame.Id = reader.U32Le();
    frame.Code = static_cast<qint32>(reader.U32Le());
    frame.Number = static_cast<qint64>(reader.U64Le());
    frame.Text = QString::fromUtf8(bytes_.constData() + kLengthSize + kHeadSize, length - kHeadSize);
    broken_ = kind > static_cast<quint8>(FrameKind::Answer);
    if (broken_) return std::nullopt;
    bytes_.remove(0, kLengthSize + length);
    return frame;
}
