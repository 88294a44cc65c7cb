#include "MusicManagment/playlist/PlayListFiles.h"

#include "CommonRUKTools/FileSource.h"
#include "CommonRUKTools/SafeFile.h"
#include "MusicManagment/playlist/ListBuilder.h"

namespace {

// A list of as many entries as are allowed, each with a record of usual size, is smaller.
constexpr std::int64_t kLargestFile = std::int64_t{1} << 30;

using Writer = void (*)(ByteWriter& file, std::span<const EntryToSave> entries);

Writer WriterOf(PlayListFormat format) {
    switch (format) {
        case PlayListFormat::Native:
            return WriteNativeList;
        case PlayListFormat::M3u:
            return WriteM3uList;
        case PlayListFormat::M3u8:
            return WriteM3u8List;
        case PlayListFormat::Pls:
            return WritePlsList;
        case PlayListFormat::Plain:
            break;
    }
    return WritePlainList;
}

}  // namespace

std::vector<PlayListEntry> ReadPlayList(const ListRules& rules, const ListOrigin& origin) {
    FileSource source(origin.FileName);
    if (source.Size() > kLargestFile) ThrowListTooLarge();
    return rules.Parse(source.ReadExactly(0, static_cast<std::size_t>(source.Size())), origin);
}

void WritePlayList(const QString& fileName, PlayListFormat format, std::span<const EntryToSave> entries) {
    ByteWriter bytes;
    WriterOf(format)(bytes, entries);
    SafeFile file(fileName);
    file.Write(bytes.Bytes());
    file.Commit();
}
