#include "CommonRUKTools/CodePage.h"
#include "MusicManagment/playlist/ListBuilder.h"
#include "MusicManagment/playlist/ListNames.h"
#include "MusicManagment/playlist/PlayListFiles.h"

// One path a line.

std::vector<PlayListEntry> ParsePlainList(ByteSpan contents, const QString& folder) {
    ListBuilder list;
    LineReader lines(contents);
    while (const auto line = lines.Next())
        list.Add({.Name = NameFromList(*line, folder)});
    return list.Take();
}

void WritePlainList(ByteWriter& file, std::span<const EntryToSave> entries) {
    for (const auto& [entry, path] : entries)
        if (!path.isEmpty()) file.Raw(AllOf(PathForList(path, CodePage::ToSystem) + "\r\n"));
}
