#pragma once

#include <string>
#include <utility>
#include <vector>

#include "ReadMPEGHeader/TagWriting.h"
#include "tests/ReadMPEGHeader/Builders.h"

// The file that a patch makes.
inline Bytes Patched(ByteSpan file, const FilePatch& patch) {
    ByteWriter result;
    for (const FilePatch::Piece& piece : patch.Pieces()) {
        if (piece.IsKept())
            result.Raw(
                file.subspan(static_cast<std::size_t>(piece.From), static_cast<std::size_t>(piece.Length)));
        else
            result.Raw(piece.Bytes);
    }
    return result.Bytes();
}

inline const QString kTagPath = QStringLiteral("/music/name.mp3");

inline FilePatch PlanOf(ByteSpan file, const TagEdit& edit, ReadProfile profile = ReadProfile::Modern) {
    MemorySource source(file);
    return PlanTag(source, kTagPath, edit, {profile});
}

inline Bytes Tagged(ByteSpan file, const TagEdit& edit, ReadProfile profile = ReadProfile::Modern) {
    return Patched(file, PlanOf(file, edit, profile));
}

// The edit that changes what `change` does to the record that is read of the file.
template <typename Change>
TagEdit EditOf(ByteSpan file, Change change, ReadProfile profile = ReadProfile::Modern) {
    TagEdit edit;
    edit.Record = ReadingOf(file, profile, kTagPath).Tag;
    change(edit);
    return edit;
}

using FrameList = std::vector<std::pair<std::string, std::string>>;  // id and body

// The frames of a tag of version 2.3 without any flags.
inline FrameList FramesIn(ByteSpan frames) {
    FrameList list;
    ByteReader reader(frames);
    while (reader.Remaining() >= 10 && reader.Rest()[0] != 0) {
        std::string id(AsText(reader.Take(4)));
        const std::uint32_t size = reader.U32Be();
        reader.Skip(2);
        list.emplace_back(std::move(id), AsText(reader.Take(size)));
    }
    return list;
}
inline FrameList FramesOfTag(ByteSpan file, std::size_t position = 0) {
    return FramesIn(file.subspan(position + 10));
}
// Those that say what this program knows of the sound, of which every written tag has some.
inline FrameList WithoutTechnical(FrameList frames) {
    std::erase_if(frames, [](const auto& frame) {
        return frame.first == "TFLT" || frame.first == "TLEN" || frame.first == "XRUK";
    });
    return frames;
}
