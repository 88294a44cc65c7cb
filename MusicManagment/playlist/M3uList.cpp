#include "MusicManagment/playlist/ListNames.h"
#include "MusicManagment/playlist/PlayListFiles.h"

// Extended M3U: one path a line, before it a remark with length, artist and title.

namespace {

constexpr std::string_view kRemark = "#EXTINF:";

}  // namespace

std::vector<PlayListEntry> ParseM3uList(ByteSpan contents) {
    std::vector<PlayListEntry> entries;
    LineReader lines(contents);
    while (const auto line = lines.Next())
        if (!StartsWith(*line, kRemark)) AppendEntry(entries, {.Name = NameFromList(*line)});
    return entries;
}

void WriteM3uList(ByteWriter& file, std::span<const EntryToSave> entries) {
    file.Raw("#EXTM3U\r\n");
    for (const auto& [entry, path] : entries) {
        if (path.isEmpty()) continue;
        if (const auto& record = entry->Record) {
            file.Raw(kRemark);
            file.Raw(AllOf(QByteArray::number(record->Length) + ',' +
                           TitleForList(record->Artist, record->Title) + "\r\n"));
        }
        file.Raw(AllOf(PathForList(path) + "\r\n"));
    }
}
