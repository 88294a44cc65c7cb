#include "MusicManagment/playlist/PlayListFiles.h"

#include "CommonRUKTools/FileSource.h"
#include "CommonRUKTools/SafeFile.h"
#include "MusicManagment/playlist/ListRecognition.h"

using namespace Qt::StringLiterals;

namespace {

// A list of as many entries as are allowed, each with a record of usual size, is smaller.
constexpr std::int64_t kLargestFile = std::int64_t{1} << 30;

struct Format {
    PlayListFormat Kind;
    std::vector<PlayListEntry> (*Parse)(ByteSpan contents);
    void (*Write)(ByteWriter& file, std::span<const EntryToSave> entries);
};

constexpr Format kFormats[] = {
    {PlayListFormat::Native, ParseNativeList, WriteNativeList},
    {PlayListFormat::M3u, ParseM3uList, WriteM3uList},
    {PlayListFormat::Pls, ParsePlsList, WritePlsList},
    {PlayListFormat::Plain, ParsePlainList, WritePlainList},
};

const Format& FormatOf(PlayListFormat kind) {
    return kFormats[static_cast<std::size_t>(kind)];
}

[[noreturn]] void ThrowTooLarge() {
    throw EPlayListException(u"Diese PlayList ist zu groß."_s);
}

}  // namespace

std::vector<PlayListEntry> ParsePlayList(ByteSpan file) {
    const RecognizedList list = RecognizeList(file);
    return FormatOf(list.Format).Parse(list.Contents);
}

std::vector<PlayListEntry> ReadPlayList(const QString& fileName) {
    FileSource source(fileName);
    if (source.Size() > kLargestFile) ThrowTooLarge();
    return ParsePlayList(source.ReadExactly(0, static_cast<std::size_t>(source.Size())));
}

void WritePlayList(const QString& fileName, std::span<const EntryToSave> entries) {
    ByteWriter bytes;
    FormatOf(FormatOfName(fileName)).Write(bytes, entries);
    SafeFile file(fileName);
    file.Write(bytes.Bytes());
    file.Commit();
}

void AppendEntry(std::vector<PlayListEntry>& entries, PlayListEntry entry) {
    if (entries.size() >= kMostListEntries) ThrowTooLarge();
    entries.push_back(std::move(entry));
}
