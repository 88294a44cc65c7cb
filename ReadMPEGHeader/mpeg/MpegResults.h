#pragma once

#include <QString>
#include <QtGlobal>

// What the last MPEG analysis found beside the record; reset by every call of ReadAudioFile.
struct MpegResults {
    qint32 FrameSize = -1;  // bytes; the average where a VBR header tells it
    qint32 FrameCount = -1;
    int VbrMarker = -1;  // a byte of the VBR header; 0 when there is none
    QString VbrName;     // "Xing", "FhG (VBRI)" or empty
};

// Process-wide: valid until the next call of ReadAudioFile.
const MpegResults& LastMpegResults();

// For the reader of sound files only.
void StoreMpegResults(const MpegResults& results);
