// Playlists of every format, as they come. A list that is read is written in each format, and the native one
// must hold the same names again.

#include <cstdlib>

#include "MusicManagment/playlist/PlayListFiles.h"

namespace {

std::vector<EntryToSave> ToSave(const std::vector<PlayListEntry>& entries) {
    std::vector<EntryToSave> toSave;
    for (const PlayListEntry& entry : entries)
        toSave.push_back({&entry, entry.Name});
    return toSave;
}

// Two kinds of names do not come back: those that are cut, and a byte-order mark at the head of one, which is
// taken for what it is.
bool ComesBack(const QString& name) {
    constexpr qsizetype kNeverCut = 20'000;  // code units, each of three bytes at most
    return name.size() < kNeverCut && !name.startsWith(QChar::ByteOrderMark);
}

void CheckNames(const std::vector<PlayListEntry>& entries, const std::vector<PlayListEntry>& again) {
    if (entries.size() != again.size()) std::abort();
    for (std::size_t i = 0; i < entries.size(); ++i)
        if (ComesBack(entries[i].Name) && entries[i].Name != again[i].Name) std::abort();
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    std::vector<PlayListEntry> entries;
    try {
        entries = ParsePlayList({data, size});
    } catch (const EPlayListException&) {
        return 0;
    }
    const auto toSave = ToSave(entries);
    for (const auto write : {WriteM3uList, WritePlsList, WritePlainList}) {
        ByteWriter file;
        write(file, toSave);
        ParsePlayList(file.Bytes());
    }
    ByteWriter native;
    WriteNativeList(native, toSave);
    CheckNames(entries, ParsePlayList(native.Bytes()));
    return 0;
}
