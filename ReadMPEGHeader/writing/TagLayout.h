#pragma once

#include <QString>
#include <cstdint>
#include <optional>
#include <vector>

#include "CommonRUKTools/FileSource.h"

struct FileRange {
    std::int64_t Begin = 0;
    std::int64_t End = 0;

    std::int64_t Length() const { return End - Begin; }
};

// Where sound and tags stand in a file.
struct TagLayout {
    enum class Kind { Mpeg, Wave, Wma };

    Kind Container = Kind::Mpeg;
    std::vector<std::int64_t> Tags{};     // positions of the ID3v2 tags, the one that our reader takes first
    bool AreLeadingTagsWhole = true;      // false: their frames are not all there is to them
    FileRange Sound{};                    // with whatever else is no tag of ours
    std::vector<FileRange> Behind{};      // APE tags
    std::optional<std::int64_t> Id3v1{};  // the last one of the file
};

// Throws EStreamError for a file that is no MPEG, WAV or WMA sound, and for a leading tag of unknown version
// or one that ends beyond the file.
TagLayout FindTags(ByteSource& file, const QString& path);
