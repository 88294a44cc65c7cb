#include "CommonRUKTools/CodePage.h"

#include <array>
#include <cstring>
#include <memory>

#include "CommonRUKTools/Errors.h"

using namespace Qt::StringLiterals;

namespace {

// Windows-1252, bytes 0x80 to 0x9F; the five unassigned codes map to themselves, as the system's own tables
// do.
constexpr std::array<char16_t, 32> kCodes1252 = {
    0x20AC, 0x0081, 0x201A, 0x0192, 0x201E, 0x2026, 0x2020, 0x2021, 0x02C6, 0x2030, 0x0160,
    0x2039, 0x0152, 0x008D, 0x017D, 0x008F, 0x0090, 0x2018, 0x2019, 0x201C, 0x201D, 0x2022,
    0x2013, 0x2014, 0x02DC, 0x2122, 0x0161, 0x203A, 0x0153, 0x009D, 0x017E, 0x0178};

#ifdef Q_OS_WIN
constexpr auto kSystem = QStringConverter::System;
#else
constexpr auto kSystem = QStringConverter::Utf8;
#endif

struct LegacyPage {
    QString name = u"windows-1252"_s;
    bool is1252 = true;
};

LegacyPage& Legacy() {
    static LegacyPage page;
    return page;
}

QByteArrayView View(ByteSpan bytes) {
    return {reinterpret_cast<const char*>(bytes.data()), static_cast<qsizetype>(bytes.size())};
}

std::size_t AsciiPrefix(ByteSpan bytes) {
    std::size_t i = 0;
    // Eight bytes at a time: most texts are ASCII throughout.
    for (std::uint64_t eight = 0; i + sizeof(eight) <= bytes.size(); i += sizeof(eight)) {
        std::memcpy(&eight, bytes.data() + i, sizeof(eight));
        if ((eight & 0x8080808080808080u) != 0) break;
    }
    while (i < bytes.size() && bytes[i] < 0x80)
        ++i;
    return i;
}

// Length of the UTF-8 sequence at `bytes`, 0 when it is malformed, overlong, a surrogate or above U+10FFFF.
std::size_t SequenceLength(ByteSpan bytes) {
    const auto first = bytes[0];
    const std::size_t length = first < 0x80   ? 1
                               : first < 0xC2 ? 0
                               : first < 0xE0 ? 2
                               : first < 0xF0 ? 3
                               : first < 0xF5 ? 4
                                              : 0;
    if (length == 0 || length > bytes.size()) return 0;
    for (std::size_t i = 1; i < length; ++i)
        if ((bytes[i] & 0xC0) != 0x80) return 0;
    if (length < 3) return length;
    const auto second = bytes[1];
    const bool bad = (first == 0xE0 && second < 0xA0) || (first == 0xED && second > 0x9F) ||
                     (first == 0xF0 && second < 0x90) || (first == 0xF4 && second > 0x8F);
    return bad ? 0 : length;
}

bool IsValidFrom(ByteSpan bytes, std::size_t start) {
    for (std::size_t i = start; i < bytes.size();) {
        const auto length = SequenceLength(bytes.subspan(i));
        if (length == 0) return false;
        i += length;
        i += AsciiPrefix(bytes.subspan(i));
    }
    return true;
}

QString From1252(ByteSpan bytes) {
    QString text(static_cast<qsizetype>(bytes.size()), Qt::Uninitialized);
    auto* out = text.data();
    for (const char16_t byte : bytes)
        *out++ = QChar(byte >= 0x80 && byte < 0xA0 ? kCodes1252[byte - 0x80u] : byte);
    return text;
}

// The byte of a character in Windows-1252, -1 when it has none.
int Byte1252(char16_t code) {
    if (code < 0x80 || (code >= 0xA0 && code <= 0xFF)) return code;
    for (std::size_t i = 0; i < kCodes1252.size(); ++i)
        if (kCodes1252[i] == code) return static_cast<int>(0x80 + i);
    return -1;
}

QString FromLegacyPage(ByteSpan bytes) {
    if (Legacy().is1252) return From1252(bytes);
    QStringDecoder decoder(Legacy().name.toLatin1().constData());
    return decoder.decode(View(bytes));
}

// The legacy bytes of one character (a surrogate pair counts as one), empty when the page does not hold it.
QByteArray LegacyCharacter(QStringView character) {
    if (Legacy().is1252) {
        const int byte = character.size() == 1 ? Byte1252(character[0].unicode()) : -1;
        return byte < 0 ? QByteArray() : QByteArray(1, static_cast<char>(byte));
    }
    QStringEncoder encoder(Legacy().name.toLatin1().constData());
    const QByteArray bytes = encoder.encode(character);
    return encoder.hasError() ||
                   FromLegacyPage(AsBytes({bytes.constData(), static_cast<std::size_t>(bytes.size())})) !=
                       character
               ? QByteArray()
               : bytes;
}

QByteArray NearestLegacy(QStringView character) {
    const QString decomposed = character.toString().normalized(QString::NormalizationForm_KD);
    QByteArray bytes;
    for (const QChar part : decomposed) {
        if (part.isMark()) continue;
        bytes += LegacyCharacter(QStringView(&part, 1));
    }
    return bytes.isEmpty() ? QByteArray("?") : bytes;
}

template <typename Handler>
void ForEachCharacter(QStringView text, Handler handler) {
    for (qsizetype i = 0; i < text.size();) {
        const bool pair = text[i].isHighSurrogate() && i + 1 < text.size() && text[i + 1].isLowSurrogate();
        const qsizetype length = pair ? 2 : 1;
        if (!handler(text.mid(i, length))) return;
        i += length;
    }
}

QString FromUtf16(ByteSpan bytes, std::size_t high) {
    QString text(static_cast<qsizetype>(bytes.size() / 2), Qt::Uninitialized);
    for (qsizetype i = 0; i < text.size(); ++i) {
        const auto at = 2 * static_cast<std::size_t>(i);
        text[i] = QChar(static_cast<char16_t>((bytes[at + high] << 8) | bytes[at + 1 - high]));
    }
    return text;
}

}  // namespace

namespace CodePage {

void SetLegacyName(const QString& name) {
    const bool is1252 = name.compare(u"windows-1252"_s, Qt::CaseInsensitive) == 0;
    if (!is1252 && !QStringDecoder(name.toLatin1().constData()).isValid())
        throw ERukException(u"Unbekannte Zeichentabelle: "_s + name);
    Legacy() = {name, is1252};
}

QString LegacyName() {
    return Legacy().name;
}

bool IsValidUtf8(ByteSpan bytes) {
    return IsValidFrom(bytes, AsciiPrefix(bytes));
}

QString FromSystem(ByteSpan bytes) {
    const auto ascii = AsciiPrefix(bytes);
    if (ascii == bytes.size()) return QString::fromLatin1(View(bytes));
    return IsValidFrom(bytes, ascii) ? QString::fromUtf8(View(bytes)) : FromLegacyPage(bytes);
}

QByteArray ToSystem(QStringView text) {
    return QStringEncoder(kSystem, QStringConverter::Flag::Stateless).encode(text);
}

SystemEncoder::SystemEncoder() : encoder_(kSystem, QStringConverter::Flag::Stateless) {}

std::size_t SystemEncoder::Space(qsizetype length) const {
    return static_cast<std::size_t>(encoder_.requiredSpace(length));
}

std::size_t SystemEncoder::Write(QStringView text, std::span<std::uint8_t> target) {
    Q_ASSERT(target.size() >= Space(text.size()));
    auto* begin = reinterpret_cast<char*>(target.data());
    return static_cast<std::size_t>(encoder_.appendToBuffer(begin, text) - begin);
}

QString FromLegacy(ByteSpan bytes) {
    return FromSystem(bytes);
}

bool FitsLegacy(QStringView text) {
    bool fits = true;
    ForEachCharacter(text,
                     [&fits](QStringView character) { return fits = !LegacyCharacter(character).isEmpty(); });
    return fits;
}

QByteArray ToLegacy(QStringView text) {
    // Most texts are ASCII throughout, which is the same in every page.
    if (QtPrivate::isAscii(text)) return text.toLatin1();
    QByteArray bytes;
    ForEachCharacter(text, [&bytes](QStringView character) {
        const QByteArray exact = LegacyCharacter(character);
        bytes += exact.isEmpty() ? NearestLegacy(character) : exact;
        return true;
    });
    return bytes;
}

QString FromUtf16Le(ByteSpan bytes) {
    return FromUtf16(bytes, 1);
}

QString FromUtf16Be(ByteSpan bytes) {
    return FromUtf16(bytes, 0);
}

QString FromUtf8(ByteSpan bytes) {
    return QString::fromUtf8(View(bytes));
}

QByteArray CutSystem(QByteArray text, qsizetype limit) {
    const ByteSpan cut = CutSystem(AsBytes({text.constData(), static_cast<std::size_t>(text.size())}),
                                   static_cast<std::size_t>(limit));
    text.truncate(static_cast<qsizetype>(cut.size()));
    return text;
}

ByteSpan CutSystem(ByteSpan text, std::size_t limit) {
    if (text.size() <= limit) return text;
#ifndef Q_OS_WIN
    const std::size_t whole = limit;
    while (limit > 0 && whole - limit < 4 && (text[limit] & 0xC0) == 0x80)
        --limit;
#endif
    return text.first(limit);
}

}  // namespace CodePage
