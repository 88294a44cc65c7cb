#pragma once

#include <QString>
#include <QStringList>
#include <functional>
#include <memory>
#include <vector>

#include "CommonRUKTools/FilePatch.h"
#include "MusicManagment/database/journal/Journal.h"

class BatchRun;
struct PlannedItem;
class TMusicDatabase;

// What came of the steps of one item.
struct ItemResult {
    int StepsDone = 0;
    QString Message{};   // why the next one failed; empty when all were done
    int OtherNames = 0;  // hard links under which the new version is seen as well; for the user to know

    bool IsComplete() const { return Message.isEmpty(); }
};

// What is to happen with one song or file: steps in their order. The first that fails ends them; those before
// it stay. A new version of a file comes before its move, and there is one at most.
class FileItem {
 public:
    // `expected`: the file that the patch was made for.
    FileItem& Patch(const QString& path, FilePatch patch, const FileState& expected);
    FileItem& Move(const QString& from, const QString& to);
    // `banned` decides about the words when the bin does not take it.
    FileItem& Trash(const QString& path, bool banned = false);
    // The song's record as it is and as it is to be; only what differs changes. Without the first it comes
    // into the collection, without the second it goes.
    FileItem& Record(std::optional<TID3Tag> before, std::optional<TID3Tag> after);
    // An entry that the list does not have, or has.
    FileItem& Ban(const QString& entry);
    FileItem& Unban(const QString& entry);
    // Told once, when it is known: with this item's group, or at once when it cannot begin. Must not throw.
    FileItem& Then(std::function<void(const ItemResult&)> done);

 private:
    friend class FileBatch;
    struct Wanted {
        StepKind Kind;
        QString Path{};
        QString To{};
        FilePatch Patch{};
        FileState Expected{};
        bool IsBanned = false;
        RecordChange Record{};
        BanChange Ban{};
    };
    PlannedItem Plan() const;

    std::vector<Wanted> steps_;
    std::function<void(const ItemResult&)> done_;
};

// Carries out changes of files and songs so that they can be taken back as one, also when the program ends in
// the middle. Items are carried out in groups, so that the disk is waited for once a group. A failed item is
// told and does not stop the others.
class FileBatch {
 public:
    // `journal` may be missing: what is done then cannot be taken back, neither by the user nor after a crash
    // of a file that is written in place. `database` may be missing when no records and bans change.
    // `caption`: what the user takes back, as a menu names it. Throws EJournalBusy, EStreamError, and
    // EMusicDatabaseException when the database takes no changes now.
    FileBatch(Journal* journal, TMusicDatabase* database, const QString& caption);
    // Finishes.
    ~FileBatch();
    FileBatch(const FileBatch&) = delete;
    FileBatch& operator=(const FileBatch&) = delete;

    // May be carried out now or later; an item that touches files of an earlier one waits for that. Never
    // throws because of a file.
    void Add(FileItem item);
    // Carries out everything that was added: before a question whose answer depends on it.
    void Settle();
    // Settles and ends the batch; a caption given now, with the right number, takes the place of the first.
    // Call it when the database has been saved, where that follows: until then a crash counts the batch as
    // unfinished, and the next start brings the database into agreement with the files.
    void Finish(const QString& caption = {});

    int ItemsDone() const { return done_; }
    const QStringList& Failures() const { return failures_; }  // messages
    // Paths of the songs whose records have changed or came, after Settle.
    const QStringList& Songs() const { return songs_; }

 private:
    void Note(const FileItem& item, const ItemResult& result);
    void ApplyWhatIsDone();

    Journal* journal_;
    TMusicDatabase* database_;
    std::unique_ptr<BatchRun> run_;
    std::vector<RecordChange> records_;  // done on the disk, not yet in the database
    std::vector<BanChange> bans_;
    bool bannListChanged_ = false;
    QStringList songs_;
    QStringList failures_;
    int done_ = 0;
};
