#include "ReadMPEGHeader/writing/FrameTexts.h"

#include <algorithm>
#include <array>

#include "ReadMPEGHeader/Genres.h"
#include "ReadMPEGHeader/id3v2/GenreText.h"
#include "ReadMPEGHeader/id3v2/ID3v2FrameBody.h"
#include "ReadMPEGHeader/writing/FrameTextWriter.h"

namespace {

// What stands behind the encoding byte: 't' a text and its end, 'V' values up to the end of the frame, 'L'
// the same as a list that stays one, 'T' a text up to there, 'l' single bytes and a zero, a digit so many
// bytes, 's' texts with a time of four bytes each, 'r' whatever is left.
struct LayoutRow {
    std::string_view Id;
    std::string_view Layout;
};

// https://id3.org/id3v2.4.0-frames
constexpr std::array<LayoutRow, 11> kLayouts = {{
    {"TXXX", "tV"},
    {"WXXX", "tr"},
    {"COMM", "3tT"},
    {"USLT", "3tT"},
    {"USER", "3T"},
    {"SYLT", "5ts"},
    {"APIC", "l1tr"},
    {"GEOB", "lttr"},
    {"OWNE", "l8T"},
    {"COMR", "l8l1ttlr"},
    {"IPLS", "L"},
}};

std::string_view LayoutOf(std::string_view id) {
    const auto row = std::ranges::find(kLayouts, id, &LayoutRow::Id);
    if (row != kLayouts.end()) return row->Layout;
    return id.starts_with('T') ? "V" : "";
}

// A piece of a body: a text, or bytes that stay.
struct Piece {
    bool IsText = false;
    bool HasEnd = false;  // a terminator follows
    QString Text{};
    std::vector<std::uint8_t> Bytes{};
};

class BodyPieces {
 public:
    BodyPieces(std::string_view id, ByteSpan body) : id_(id), fields_(body, TextRules::Id3v24) {
        fields_.ReadEncoding();
    }

    bool Parse(std::string_view layout) {
        return std::ranges::all_of(layout, [this](char part) { return Take(part); });
    }
    const std::vector<Piece>& Pieces() const { return pieces_; }
    bool HasJoinedValues() const { return hasJoinedValues_; }

 private:
    bool Take(char part) {
        switch (part) {
            case 't':
                return TakeText();
            case 'T':
                pieces_.push_back({.IsText = true, .Text = fields_.Text()});
                return true;
            case 'V':
                return TakeValues();
            case 'L':
                return TakeList();
            case 'l':
                return TakeLatin();
            case 's':
                return TakeTimedTexts();
            case 'r':
                return TakeBytes(fields_.Remaining());
            default:
                return TakeBytes(static_cast<std::size_t>(part - '0'));
        }
    }

    bool TakeText() {
        if (!fields_.TextHasEnd()) return false;
        pieces_.push_back({.IsText = true, .HasEnd = true, .Text = fields_.Text()});
        return true;
    }

    bool TakeBytes(std::size_t count) {
        if (count > fields_.Remaining()) return false;
        const ByteSpan bytes = fields_.Take(count);
        pieces_.push_back({.Bytes = {bytes.begin(), bytes.end()}});
        return true;
    }

    // The last ones of a frame may be left out.
    bool TakeLatin() {
        if (fields_.Remaining() == 0) return true;
        const ByteSpan rest = FrameBody(fields_).Rest();
        const auto end = std::ranges::find(rest, 0);
        return end != rest.end() && TakeBytes(static_cast<std::size_t>(end - rest.begin()) + 1);
    }

    bool TakeTimedTexts() {
        while (fields_.Remaining() > 0)
            if (!TakeText() || !TakeBytes(4)) return false;
        return true;
    }

    QStringList RestOfTexts() {
        QStringList texts;
        while (fields_.Remaining() > 0)
            texts += fields_.Text();
        return texts;
    }

    bool TakeValues() {
        QStringList values = RestOfTexts();
        values.removeAll(QString());
        hasJoinedValues_ = values.size() > 1;
        pieces_.push_back({.IsText = true, .Text = id_ == "TCON" ? JoinedGenres(values) : values.join(u'/')});
        return true;
    }

    bool TakeList() {
        for (const QString& text : RestOfTexts())
            pieces_.push_back({.IsText = true, .HasEnd = true, .Text = text});
        return true;
    }

    // Version 2.4 writes numbers without parentheses, and of several genres the first that is known counts.
    static QString JoinedGenres(const QStringList& values) {
        const auto genre = ParseGenre(TextRules::Id3v24, values).Genre;
        const QString text = values.join(u'/');
        if (ParseGenre(TextRules::Id3v23, {text}).Genre == genre || !genre) return text;
        return QStringLiteral("(%1)").arg(*genre) + text;
    }

    std::string_view id_;
    FrameBody fields_;
    std::vector<Piece> pieces_;
    bool hasJoinedValues_ = false;
};

std::vector<std::uint8_t> Written(const std::vector<Piece>& pieces, const WritingRules& rules) {
    QStringList all;
    for (const Piece& piece : pieces)
        if (piece.IsText) all += piece.Text;
    const FrameTextWriter texts(rules, all);
    ByteWriter body;
    body.U8(texts.Encoding());
    for (const Piece& piece : pieces) {
        body.Raw(piece.Bytes);
        if (piece.IsText) texts.Text(body, piece.Text);
        if (piece.HasEnd) texts.Terminator(body);
    }
    return body.Bytes();
}

}  // namespace

std::optional<std::vector<std::uint8_t>> BodyWithTexts23(std::string_view id, ByteSpan body,
                                                         const WritingRules& rules) {
    const std::string_view layout = LayoutOf(id);
    if (layout.empty() || body.empty()) return std::nullopt;
    BodyPieces pieces(id, body);
    const bool isKnownEncoding = body[0] <= 1;
    if (!pieces.Parse(layout) || (isKnownEncoding && !pieces.HasJoinedValues())) return std::nullopt;
    return Written(pieces.Pieces(), rules);
}

QStringList TextValues(ByteSpan body) {
    FrameBody fields(body, TextRules::Id3v24);
    fields.ReadEncoding();
    QStringList values;
    while (fields.Remaining() > 0)
        values += fields.Text();
    return values;
}
