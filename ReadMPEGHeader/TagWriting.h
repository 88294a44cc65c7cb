#pragma once

#include <QByteArray>
#include <QString>
#include <optional>
#include <variant>

#include "CommonRUKTools/ByteWriter.h"
#include "CommonRUKTools/FilePatch.h"
#include "CommonRUKTools/FileSource.h"
#include "ReadMPEGHeader/ID3Tag.h"
#include "ReadMPEGHeader/SongReading.h"

// Computes what a file's bytes become when its tags change. Nothing here touches a file.

// The frames of a whole ID3v2.3 tag for the record, in their fixed order. `trackTotal`: 0 when unknown.
void WriteID3v2Frames(ByteWriter& stream, int trackTotal, const TID3Tag& tag,
                      ReadProfile profile = ReadProfile::Classic);

enum class TagPlace {
    Leading,      // the tag with 1,024 bytes of padding, then what `file` held
    BehindAudio,  // at the end of `file`, with the trailer "ID32" that leads to it
};
// Adds a tag to a file without one. Throws EStreamError when it does not fit the format's numbers.
void WriteID3v2Tag(ByteWriter& file, const TID3Tag& tag, TagPlace place,
                   ReadProfile profile = ReadProfile::Classic);

struct TagWriteOptions {
    // Classic: what the program has always written. Modern: what other programs understand, too, and nothing
    // that would read back as something else.
    ReadProfile Profile = ReadProfile::Classic;
};

struct CoverRemoval {
    bool operator==(const CoverRemoval&) const = default;
};
struct CoverPicture {
    QByteArray Bytes;  // of an image file
    QString MimeType;  // "image/jpeg"
    bool operator==(const CoverPicture&) const = default;
};
// Front covers only; pictures of other types stay.
using CoverChange = std::variant<CoverRemoval, CoverPicture>;

struct TagEdit {
    TID3Tag Record{};                    // whole: what does not change is there, too
    std::optional<int> TrackTotal{};     // 0 for none; nothing: it stays
    std::optional<CoverChange> Cover{};  // nothing: it stays
};

// The patch that gives a file the tags of the record. It changes nothing where the file's tags say so
// already. What the record does not hold (pictures, lyrics, foreign frames) is kept. `path` gives the name.
// Throws EStreamError, with a message that names the file, for a file that is no MPEG, WAV or WMA sound and
// for tags that cannot be changed safely; EMediumError when the medium fails.
FilePatch PlanTag(ByteSource& file, const QString& path, const TagEdit& edit, const TagWriteOptions& options);

// The patch that takes out ID3v1, every leading ID3v2 tag, and tags that a trailer leads to; an APE tag
// stays. Throws as PlanTag.
FilePatch PlanTagRemoval(ByteSource& file, const QString& path);

// The total of "TRCK" ("3/12"); nothing when it is unknown.
std::optional<int> ReadTrackTotal(ByteSource& file);
