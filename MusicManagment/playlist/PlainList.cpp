#include "MusicManagment/playlist/ListNames.h"
#include "MusicManagment/playlist/PlayListFiles.h"

// One path a line.

std::vector<PlayListEntry> ParsePlainList(ByteSpan contents) {
    std::vector<PlayListEntry> entries;
    LineReader lines(contents);
    while (const auto line = lines.Next())
        AppendEntry(entries, {.Name = NameFromList(*line)});
    return entries;
}

void WritePlainList(ByteWriter& file, std::span<const EntryToSave> entries) {
    for (const auto& [entry, path] : entries)
        if (!path.isEmpty()) file.Raw(AllOf(PathForList(path) + "\r\n"));
}
