#pragma once

#include <QString>
#include <optional>

#include "CommonRUKTools/ByteWriter.h"
#include "ReadMPEGHeader/ID3Tag.h"
#include "ReadMPEGHeader/SongReading.h"
#include "ReadMPEGHeader/id3v2/CommentFields.h"
#include "ReadMPEGHeader/id3v2/ID3v2FrameBody.h"

// How a record is put into frames; one implementation for each value of ReadProfile.
class WritingRules {
 public:
    virtual ~WritingRules() = default;

    // How the frames are read again.
    virtual TextRules Reading() const = 0;
    // True for a text that is written with encoding 0, in the legacy code page.
    virtual bool IsSingleByte(const QString& text) const = 0;
    // The text of "TCON"; nothing: there is no such frame.
    virtual std::optional<QString> GenreText(const TID3Tag& record) const = 0;
    // The text of "TRCK". `total`: 0 when unknown.
    virtual std::optional<QString> TrackText(int track, int total) const = 0;
    virtual void WritePlayCount(ByteWriter& body, quint32 count) const = 0;
    virtual CommentFields SplitComment(const QString& comment) const = 0;
};

const WritingRules& WritingRulesOf(ReadProfile profile);

// "3/12"; a track above the total drops it, and a total of 0 is none.
QString NumberedTrack(int track, int total);
