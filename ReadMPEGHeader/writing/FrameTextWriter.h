#pragma once

#include <QString>
#include <cstdint>
#include <vector>

#include "CommonRUKTools/ByteWriter.h"
#include "ReadMPEGHeader/writing/WritingRules.h"

// Writes the texts of one frame, which share an encoding: 0 where the rules have every one of them in single
// bytes, else 1, UTF-16 little-endian, each with its mark. A text ends at its first zero character.
class FrameTextWriter {
 public:
    FrameTextWriter(const WritingRules& rules, const QStringList& texts);

    std::uint8_t Encoding() const { return wide_ ? 1 : 0; }
    void Text(ByteWriter& body, const QString& text) const;
    void Terminator(ByteWriter& body) const { body.Zeros(wide_ ? 2 : 1); }

 private:
    bool wide_ = false;
};

// The bytes of a text that has no encoding byte: single bytes where the rules have it so, else UTF-8.
std::vector<std::uint8_t> PlainTextBytes(const WritingRules& rules, const QString& text);
