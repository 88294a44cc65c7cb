#pragma once

#include <QString>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "CommonRUKTools/ByteWriter.h"
#include "ReadMPEGHeader/writing/TagField.h"

// A frame on its way from one tag into another. Flags are those of the tag's version.
struct TagFrame {
    std::string Id;   // of ID3v2.3 and 2.4
    QString ShownId;  // as in the tag it comes from
    std::uint8_t StatusFlags = 0;
    std::uint8_t FormatFlags = 0;
    std::vector<std::uint8_t> Stored{};
    bool IsCoded = false;  // Stored is not the plain body
    std::optional<std::vector<std::uint8_t>>
        Decoded{};                    // the plain body, where it is coded and can be decoded
    std::optional<TagField> Field{};  // what it tells of a record; nothing: it is none of ours

    bool IsReadable() const { return !IsCoded || Decoded.has_value(); }
    ByteSpan Body() const { return IsCoded ? ByteSpan(Decoded.value()) : ByteSpan(Stored); }
    bool HasOldId() const { return ShownId.size() == 3; }
};

// As ID3v2.3 stores it.
void AppendFrame(ByteWriter& stream, const TagFrame& frame);
// Behind all others: some programs take a frame without a fourth letter for the end of the tag.
void MoveOddIdsBack(std::vector<TagFrame>& frames);
