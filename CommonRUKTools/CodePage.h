#pragma once

#include <QByteArray>
#include <QString>
#include <QStringConverter>
#include <QStringView>
#include <cstdint>
#include <span>

#include "CommonRUKTools/ByteReader.h"

// The only place that knows how 8-bit texts are encoded.
//
// "System" texts stand in files of the program itself (databases, playlists, lists); "legacy" texts stand in
// the tags of song files.
namespace CodePage {

// The code page of single-byte texts in tags: a name that Qt's converters know, "windows-1252" at start.
// Throws ERukException when the name is unknown.
void SetLegacyName(const QString& name);
QString LegacyName();

bool IsValidUtf8(ByteSpan bytes);

// Valid UTF-8 is taken as UTF-8, anything else as the legacy code page.
QString FromSystem(ByteSpan bytes);
// UTF-8 on Linux; on Windows the ANSI code page, with '?' for what it cannot hold.
QByteArray ToSystem(QStringView text);
// The same for many texts, into memory of the caller.
class SystemEncoder {
 public:
    SystemEncoder();
    // Bytes that a text of so many code units takes at most.
    std::size_t Space(qsizetype length) const;
    // Returns how many bytes it wrote; `target` must have the space for the text.
    std::size_t Write(QStringView text, std::span<std::uint8_t> target);

 private:
    QStringEncoder encoder_;
};

// Valid UTF-8 with at least one multi-byte sequence is taken as UTF-8, anything else as the legacy code page.
QString FromLegacy(ByteSpan bytes);
// True when the legacy code page holds every character of `text`.
bool FitsLegacy(QStringView text);
// The nearest legacy text: decomposed letters lose their marks, the rest becomes '?'.
QByteArray ToLegacy(QStringView text);

// UTF-16 code units in the given order; a lone last byte is dropped. No byte-order mark is looked for.
QString FromUtf16Le(ByteSpan bytes);
QString FromUtf16Be(ByteSpan bytes);
QString FromUtf8(ByteSpan bytes);

// At most `limit` bytes of a system text; a multi-byte character is not split.
QByteArray CutSystem(QByteArray text, qsizetype limit);
ByteSpan CutSystem(ByteSpan text, std::size_t limit);

}  // namespace CodePage
