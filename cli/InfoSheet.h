#pragma once

#include <QString>
#include <vector>

#include "ReadMPEGHeader/SongReading.h"

// What is known of one file.
struct FileInfo {
    SongReading Reading;
    std::vector<FrameReport> Frames;  // of its ID3v2 tag
};

// A sheet for people, with an empty line at its end.
QString InfoSheet(const FileInfo& info, bool withFrames);
