#include "MusicManagment/database/intake/FolderWalk.h"

#include <algorithm>

#include "CommonRUKTools/Errors.h"
#include "MusicManagment/database/RecycleBin.h"

using namespace Qt::StringLiterals;

namespace {

constexpr int kEntriesPerProgressPoint = 256;

// What a system or a program keeps for itself on a volume, above all what the user has thrown away.
constexpr QStringView kPrivateFolders[] = {u".Trash",
                                           u".Trashes",
                                           u"$RECYCLE.BIN",
                                           u"RECYCLER",
                                           u"#recycle",
                                           kOwnRecycleFolder,
                                           u"System Volume Information",
                                           u"lost+found",
                                           u".fseventsd",
                                           u".Spotlight-V100",
                                           u".snapshots"};

bool IsPrivateFolder(const FolderEntry& entry, const QString& parent) {
    const auto isName = [&entry](QStringView name) {
        return entry.Name.compare(name, Qt::CaseInsensitive) == 0;
    };
    return entry.IsSystem || std::ranges::any_of(kPrivateFolders, isName) ||
           entry.Name.startsWith(u".Trash-"_s) ||  // with the user's number behind
           (entry.Name == u"Trash"_s && parent.endsWith(u"/.local/share/"_s));  // the one of the home folder
}

}  // namespace

// What one folder holds, as paths.
struct FolderWalk::Found {
    QStringList Files;
    QStringList Folders;
};

bool FolderWalk::Walk(const QString& folder, QStringList& files) {
    // The tree may be deeper than the program's stack allows.
    waiting_.assign(1, folder);
    while (!waiting_.empty()) {
        const QString next = std::move(waiting_.back());
        waiting_.pop_back();
        if (!Visit(next, files)) return false;
    }
    return true;
}

bool FolderWalk::Visit(const QString& folder, QStringList& files) {
    if (options_.Progress && options_.Progress(folder)) return false;
    Found found;
    bool goesOn = true;
    try {
        goesOn = ReadEntries(folder, found);
    } catch (const EStreamError& error) {
        unreadable_ << error.Message();
    }
    std::sort(found.Files.begin(), found.Files.end());
    std::sort(found.Folders.begin(), found.Folders.end());
    files << found.Files;
    waiting_.insert(waiting_.end(), found.Folders.rbegin(), found.Folders.rend());
    return goesOn;
}

// False when the walk was stopped.
bool FolderWalk::ReadEntries(const QString& folder, Found& found) {
    FolderEntries entries(folder);
    if (!entered_.insert(entries.Identity()).second) return true;
    const QString prefix = folder.endsWith(u'/') ? folder : folder + u'/';
    FolderEntry entry;
    for (int count = 1; entries.Next(entry); ++count) {
        if (count % kEntriesPerProgressPoint == 0 && options_.Progress && options_.Progress(folder))
            return false;
        Sort(entry, prefix, found);
    }
    return true;
}

void FolderWalk::Sort(const FolderEntry& entry, const QString& prefix, Found& found) {
    const bool isFolder = entry.Kind == EntryKind::Folder;
    if (isFolder ? !options_.WithSubfolders : !options_.IsWanted(entry.Name)) return;
    if (isFolder && IsPrivateFolder(entry, prefix)) return;
    const QString path = prefix + entry.Name;
    if (!entry.Reachable)
        unreadable_ << (isFolder ? u"Ungültiger Ordnername: "_s : u"Ungültiger Dateiname: "_s) + path;
    else if (isFolder)
        found.Folders << path;
    else if (entry.Kind == EntryKind::File)
        found.Files << path;
    else
        unreadable_ << u"Keine gewöhnliche Datei: "_s + path;
}
