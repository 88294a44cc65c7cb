#include "CommonRUKTools/CodePage.h"
#include "MusicManagment/playlist/ListBuilder.h"
#include "MusicManagment/playlist/ListNames.h"
#include "MusicManagment/playlist/PlayListFiles.h"

// Extended M3U: one path a line, before it a remark with length, artist and title.

namespace {

void Write(ByteWriter& file, std::span<const EntryToSave> entries, ListEncoder encode) {
    file.Raw("#EXTM3U\r\n");
    for (const auto& [entry, path] : entries) {
        if (path.isEmpty()) continue;
        if (const auto& record = entry->Record) {
            file.Raw(kM3uRemark);
            file.Raw(AllOf(QByteArray::number(record->Length) + ',' +
                           TitleForList(record->Artist, record->Title, encode) + "\r\n"));
        }
        file.Raw(AllOf(PathForList(path, encode) + "\r\n"));
    }
}

}  // namespace

std::vector<PlayListEntry> ParseM3uList(ByteSpan contents, const QString& folder) {
    ListBuilder list;
    LineReader lines(contents);
    while (const auto line = lines.Next())
        if (!StartsWith(*line, kM3uRemark)) list.Add({.Name = NameFromList(*line, folder)});
    return list.Take();
}

void WriteM3uList(ByteWriter& file, std::span<const EntryToSave> entries) {
    Write(file, entries, CodePage::ToSystem);
}

void WriteM3u8List(ByteWriter& file, std::span<const EntryToSave> entries) {
    Write(file, entries, ToUtf8);
}
