#include <QFileInfo>
#include <algorithm>
#include <functional>
#include <optional>

#include "CommonRUKTools/AbsolutePath.h"
#include "CommonRUKTools/Clock.h"
#include "MusicManagment/database/Progress.h"
#include "MusicManagment/database/intake/FolderWalk.h"
#include "MusicManagment/database/intake/Intake.h"
#include "MusicManagment/playlist/PlayList.h"

// Files from outside become entries.

using namespace Qt::StringLiterals;

namespace {

constexpr qint64 kSilentTime = 100;  // ms
constexpr std::size_t kEntriesPerProgressPoint = 5;

// A drop that takes its time becomes a long operation of the database, so that the user sees how far it is
// and can stop it. Most drops are over before a window could be looked at.
class DropProgress {
 public:
    // nullptr: nobody is told, and nobody can stop it.
    explicit DropProgress(TMusicDatabase* database)
        : database_(database), tellFrom_(CurrentClock().Ticks() + kSilentTime) {}

    // True when the user wants to stop. Throws EAbort, after telling the user, when another operation is
    // going.
    bool Report(const ProgressPoint& point) {
        if (database_ == nullptr || (!run_ && CurrentClock().Ticks() < tellFrom_)) return false;
        if (!run_) run_.emplace(*database_, u"Nehme Songs in die PlayList auf"_s);
        return database_->Progress(point);
    }

 private:
    TMusicDatabase* database_;
    qint64 tellFrom_;  // ticks of the clock
    std::optional<ProgressRun> run_;
};

// The entries of a file that is a playlist.
using ListReading = std::function<std::optional<std::vector<PlayListEntry>>(const QString& path)>;

// Appends what a path stands for: a playlist for its entries, a folder for the songs in it, what is not there
// for nothing. False when the user wants to stop.
bool Expand(const QString& path, const ListReading& readIfList, DropProgress& progress,
            std::vector<PlayListEntry>& entries) {
    const auto report = [&progress](const QString& folder) {
        return progress.Report({.Description = folder});
    };
    if (report(path)) return false;
    const QFileInfo info(path);
    if (info.isDir()) {
        FolderWalk walk({.IsWanted = &IsSongFile, .Progress = report});
        QStringList files;
        if (!walk.Walk(path, files)) return false;
        for (const QString& file : files)
            entries.push_back({.Name = file});
    } else if (info.isFile()) {
        if (auto listed = readIfList(path))
            std::ranges::move(*listed, std::back_inserter(entries));
        else
            entries.push_back({.Name = path});
    }
    return true;
}

}  // namespace

// What was read before the user stopped is kept.
std::vector<PlayListEntry> TPlayList::EntriesFor(const QStringList& paths) const {
    DropProgress progress(database_);
    const ListReading readIfList = [this](const QString& path) {
        return rules_->IsListName(path) ? std::optional(ReadList(path)) : std::nullopt;
    };
    std::vector<PlayListEntry> entries;
    for (const QString& path : paths)
        if (!Expand(AbsolutePath(path), readIfList, progress, entries)) return {};
    for (std::size_t i = 0; i < entries.size(); ++i) {
        PlayListEntry& entry = entries[i];
        if (i % kEntriesPerProgressPoint == 0 && progress.Report({.Cur = static_cast<qint64>(i),
                                                                  .Max = static_cast<qint64>(entries.size()),
                                                                  .Description = entry.Name})) {
            entries.erase(entries.begin() + static_cast<std::ptrdiff_t>(i), entries.end());
            break;
        }
        const bool isSong = IsSongFile(entry.Name) || (database_ && database_->Contains(entry.Name));
        if (!entry.Record && isSong) entry.Record = FindRecord(entry.Name, -1);
    }
    return entries;
}

int TPlayList::InsertFiles(int position, const QStringList& paths) {
    std::vector<PlayListEntry> entries = EntriesFor(paths);
    position = std::clamp(position, 0, Count());
    for (PlayListEntry& entry : entries)
        Insert(position++, std::move(entry));
    return static_cast<int>(entries.size());
}
