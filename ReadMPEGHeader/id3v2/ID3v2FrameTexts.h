#pragma once

#include <QString>
#include <string_view>

#include "ReadMPEGHeader/id3v2/FrameListener.h"
#include "ReadMPEGHeader/id3v2/ID3v2FrameBody.h"

// What a listener is told of a frame: its text or a German description, and its number where it has one.
// `id`: as in ID3v2.3; `shownId`: as it stands in the tag. A frame that is not known gives its size in bytes.
FrameReport DescribeFrame(std::string_view id, const QString& shownId, FrameBody body);
