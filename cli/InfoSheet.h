#pragma once

#include <QString>
#include <vector>

#include "ReadMPEGHeader/ID3Tag.h"
#include "ReadMPEGHeader/id3v2/FrameListener.h"
#include "ReadMPEGHeader/mpeg/MpegResults.h"

// What is known of one file.
struct FileInfo {
    TID3Tag Tag;
    MpegResults Mpeg;
    std::vector<FrameReport> Frames;
    QString Error;  // empty: the file was read
};

// A sheet for people, with an empty line at its end.
QString InfoSheet(const FileInfo& info, bool withFrames);
