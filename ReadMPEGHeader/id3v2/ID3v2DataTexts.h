#pragma once

#include <QString>
#include <optional>

#include "ReadMPEGHeader/id3v2/ID3v2FrameBody.h"

// German descriptions of frames that hold data rather than a text.
struct FrameText {
    QString Text;
    std::optional<qint64> Number{};
};

FrameText BinarySizeText(FrameBody& body);    // "UFID", "MCDI"
FrameText StoredSizeText(FrameBody& body);    // "MLLT"
FrameText EventTimesText(FrameBody& body);    // "ETCO"
FrameText TempoCodesText(FrameBody& body);    // "SYTC"
FrameText PositionText(FrameBody& body);      // "POSS"
FrameText VolumeText(FrameBody& body);        // "RVAD"
FrameText EqualisationText(FrameBody& body);  // "EQUA"
FrameText ReverbText(FrameBody& body);        // "RVRB"
FrameText BufferText(FrameBody& body);        // "RBUF"
FrameText PlayCounterText(FrameBody& body);   // "PCNT"
FrameText PopularityText(FrameBody& body);    // "POPM"
FrameText PictureText(FrameBody& body);       // "APIC"
FrameText OldPictureText(FrameBody& body);    // "PIC" of ID3v2.2
FrameText ObjectText(FrameBody& body);        // "GEOB"
FrameText EncryptionText(FrameBody& body);    // "AENC"
FrameText LinkText(FrameBody& body);          // "LINK"
FrameText OwnershipText(FrameBody& body);     // "OWNE"
FrameText CommercialText(FrameBody& body);    // "COMR"
