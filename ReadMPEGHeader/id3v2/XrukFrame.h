#pragma once

#include <QString>
#include <optional>

#include "CommonRUKTools/ByteReader.h"
#include "CommonRUKTools/ByteWriter.h"
#include "ReadMPEGHeader/ID3Tag.h"

// The program's private ID3v2 frame "XRUK": every technical field of a record, so that it can be restored
// without analysing the audio. Body: 242 bytes banner, encoding 0, format text with terminating zero, 29
// bytes of packed little-endian numbers.
struct XrukFrame {
    TID3Tag Fields;  // format, bit rate to frame size, reserved word, flags, main genre, remix, file time

    // Nothing when the body is too short or the format text has no end.
    static std::optional<XrukFrame> Parse(ByteSpan body);

    // Appends the body for a record. `format`: the bytes of its format text, none of them zero.
    static void Write(ByteWriter& body, const TID3Tag& record, ByteSpan format);

    // What only the collection knows: flags, main genre, remix mark, reserved word, file time.
    void ApplyCollectionFields(TID3Tag& target) const;
    // What an analysis of the audio would have found.
    void ApplyTechnicalFields(TID3Tag& target) const;
};
