// Playlists of every format, as they come, by both sets of rules. A list that is read is written in each
// format; the native one must hold the same names again, and the others all paths when they are read by the
// modern rules.

#include <cstdlib>

#include "CommonRUKTools/AbsolutePath.h"
#include "CommonRUKTools/CodePage.h"
#include "MusicManagment/playlist/PlayListFiles.h"

namespace {

using Entries = std::vector<PlayListEntry>;

std::vector<EntryToSave> ToSave(const Entries& entries) {
    std::vector<EntryToSave> toSave;
    for (const PlayListEntry& entry : entries)
        toSave.push_back({&entry, entry.Name});
    return toSave;
}

// Entries have names of a path's length and of whole characters; others are cut or replaced.
bool IsUsual(const QString& name) {
    constexpr qsizetype kNeverCut = 20'000;  // code units, each of three bytes at most
    return name.size() < kNeverCut && QString::fromUtf8(name.toUtf8()) == name;
}

bool IsPath(const QString& name) {
    return name.startsWith(u'/') && AbsolutePath(name) == name && !name.contains(QChar::Null);
}

void CheckNames(const Entries& entries, const Entries& again) {
    if (entries.size() != again.size()) std::abort();
    for (std::size_t i = 0; i < entries.size(); ++i)
        if (IsUsual(entries[i].Name) && entries[i].Name != again[i].Name) std::abort();
}

Entries Written(void (*write)(ByteWriter&, std::span<const EntryToSave>), const Entries& entries,
                const char* fileName) {
    ByteWriter file;
    write(file, ToSave(entries));
    return kModernLists.Parse(file.Bytes(), {.FileName = QString::fromLatin1(fileName)});
}

void CheckWriting(const Entries& entries) {
    Entries paths;
    for (const PlayListEntry& entry : entries)
        if (IsPath(entry.Name) && IsUsual(entry.Name)) paths.push_back(entry);
    CheckNames(paths, Written(WriteM3uList, paths, "/l/x.m3u"));
    CheckNames(paths, Written(WritePlsList, paths, "/l/x.pls"));
    CheckNames(paths, Written(WritePlainList, paths, "/l/x.pl"));
    CheckNames(entries, Written(WriteNativeList, entries, "/l/x.rukpl"));
    // What has no path has no promise, but must not do harm.
    for (const auto write : {WriteM3uList, WritePlsList, WritePlainList})
        Written(write, entries, "/l/x");
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    for (const ListRules* rules : {&kClassicLists, &kModernLists}) {
        Entries entries;
        try {
            entries = rules->Parse({data, size}, {.FileName = QStringLiteral("/l/x.m3u")});
        } catch (const EPlayListException&) {
            continue;  // damaged, or of another version
        }
        CheckWriting(entries);
    }
    return 0;
}
