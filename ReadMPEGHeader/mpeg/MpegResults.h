#pragma once

#include <QString>
#include <QtGlobal>

// What the analysis of an MPEG frame finds beside the record; the values of a fresh one stand for a file
// without a frame.
struct MpegResults {
    qint32 FrameSize = -1;  // bytes; the average where a VBR header tells it
    qint32 FrameCount = -1;
    int VbrMarker = -1;  // a byte of the VBR header; 0 when there is none
    QString VbrName;     // "Xing", "FhG (VBRI)" or empty
};
