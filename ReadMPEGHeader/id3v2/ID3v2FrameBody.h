#pragma once

#include <QString>
#include <QStringList>
#include <cstdint>

#include "CommonRUKTools/ByteReader.h"

// How the texts of a tag are encoded.
enum class TextRules {
    Classic,  // encoding 0 is the legacy code page, any other UTF-16 little-endian
    Id3v23,   // 1: UTF-16 with byte-order mark, 2: UTF-16 big-endian, 3: UTF-8
    Id3v24,   // the same, and a text may be a list of values with zeros between them
};

// A cursor over the fields of one frame. A field that the frame does not hold reads as zero or as an empty
// text.
class FrameBody {
 public:
    FrameBody(ByteSpan bytes, TextRules rules) : reader_(bytes), rules_(rules), size_(bytes.size()) {}

    TextRules Rules() const { return rules_; }
    std::size_t Size() const { return size_; }  // of the whole frame
    std::size_t Remaining() const { return reader_.Remaining(); }

    std::uint8_t U8() { return reader_.U8(); }
    std::uint16_t U16() { return reader_.U16Be(); }
    std::uint32_t U24() { return reader_.U24Be(); }
    std::uint32_t U32() { return reader_.U32Be(); }
    // Big-endian, `count` bytes (at most 4).
    std::uint32_t Number(std::size_t count);
    // The rest as one big-endian number; the largest 32-bit number when it does not fit.
    std::uint32_t Counter();
    // Four bytes, least significant first.
    std::uint32_t TurnedNumber() { return reader_.U32Le(); }
    ByteSpan Rest() { return reader_.Take(reader_.Remaining()); }
    ByteSpan Take(std::size_t count) { return reader_.Take(count); }  // empty when fewer are left
    void Skip(std::size_t count) { reader_.Skip(count); }

    // The encoding of the texts that follow.
    void ReadEncoding();
    // Up to the next zero character or the end of the frame; the zero is consumed.
    QString Text();
    // A text that is always single-byte (addresses, types, prices).
    QString Latin();
    QString Latin(std::size_t count);
    // True when a zero character ends the next text.
    bool TextHasEnd() const;
    // All that is left: one text, or with the rules that know lists every value.
    QStringList Values();
    // The three letters that name a language. Bytes that are none are left to the text behind.
    QString Language();

 private:
    bool IsWide() const;
    std::size_t TextLength(bool wide) const;
    QString Decode(ByteSpan bytes);
    QString DecodeWide(ByteSpan bytes);

    ByteReader reader_;
    TextRules rules_;
    std::size_t size_;
    std::uint8_t encoding_ = 0;
    bool bigEndian_ = false;  // as the last byte-order mark said; not every text of a frame brings its own
};
