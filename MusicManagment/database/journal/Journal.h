#pragma once

#include <QString>
#include <QStringList>
#include <functional>
#include <optional>
#include <vector>

#include "CommonRUKTools/Listeners.h"
#include "MusicManagment/database/journal/JournalFile.h"
#include "MusicManagment/database/journal/RecordChanges.h"

class TMusicDatabase;

// How much of what was done stays to be taken back; the oldest goes first.
struct JournalLimits {
    qint64 Bytes = qint64{512} << 20;
    std::size_t Batches = 200;
};

// A batch, as a list of them shows it.
struct BatchInfo {
    quint64 Id = 0;
    qint64 Time = 0;     // milliseconds since 1970, UTC
    QString Caption{};   // what it was, as a menu names it: "40 Tags"
    QString Database{};  // path of the one whose songs it is about; empty for files alone
    int Steps = 0;       // that are still to be taken back
    int Files = 0;
    bool NeedsDatabase = false;  // songs or entries of the ban list are among them

    // Whether it can be taken back while this one is open.
    bool IsFor(const TMusicDatabase& database) const;
};

// What a program that was ended in the middle of a batch had left.
struct RecoveryResult {
    QString Caption{};
    QString Database{};
    QStringList TakenBack{};  // paths of files that are as before again
    QStringList Problems{};   // messages about those that are not

    bool IsEmpty() const { return TakenBack.isEmpty() && Problems.isEmpty(); }
    // For the user, in one message; empty when there is nothing to tell.
    QString Message() const;
};

struct UndoResult {
    QString Caption{};
    QStringList Songs{};     // paths of the songs whose records were changed or brought back
    int Items = 0;           // that are as before
    QStringList Problems{};  // messages about those that are not
};

// The last batch belongs to another database than the one that is there.
class EOtherDatabase : public ERukException {
 public:
    explicit EOtherDatabase(const QString& database);
    const QString& Database() const { return database_; }

 private:
    QString database_;
};

// Everything that was done to files and songs and can be taken back: one file beside the standard database,
// which is also what brings files back that were half changed when the program or the computer ended. Batches
// are written by FileBatch. Whatever changes anything throws EJournalBusy while another program does.
class Journal {
 public:
    explicit Journal(QString path, JournalLimits limits = {});

    const QString& Path() const { return path_; }
    const JournalLimits& Limits() const { return limits_; }

    // --- What can be taken back, and done again: the last first ---
    std::vector<BatchInfo> Batches() const;
    std::optional<BatchInfo> ToUndo() const;
    std::optional<BatchInfo> ToRedo() const;
    // Whether a batch with so many old bytes can be written down: by the limit and by the space on the disk.
    bool FitsBatch(qint64 bytes) const;

    // --- Taking back ---
    // The last batch as a whole. What has changed since is left alone and told. `database` may be missing
    // where the batch is about files alone. Throws EOtherDatabase, and nothing has happened.
    UndoResult Undo(TMusicDatabase* database);
    UndoResult Redo(TMusicDatabase* database);
    // What a program has left half done: at the start of the program, and before each batch. Nothing while
    // another program changes files, which then is not done.
    RecoveryResult TakeBackUnfinished();
    // Brings a database that was just opened into agreement with the files: makes in it what was done with
    // its songs after its file was last saved. Returns how many songs have changed.
    int BringUpToDate(TMusicDatabase& database) const;
    // Told when something unfinished was found before a batch.
    std::function<void(const RecoveryResult&)> OnTakenBack;

    // The lists above are others now.
    mutable Listeners<> Changed;

    // --- For FileBatch ---
    // The file in our hands; what was unfinished has been taken back.
    std::unique_ptr<JournalFile> OpenForBatch();

 private:
    const JournalContents& Contents() const;
    std::unique_ptr<JournalFile> Open();

    QString path_;
    JournalLimits limits_;
    mutable JournalContents contents_;
    mutable std::vector<BatchInfo> toUndo_;  // in the order in which they were done
    mutable std::vector<BatchInfo> toRedo_;
    mutable FileState read_;  // of the file when it was read
};

// The journal in use; none unless one was set, and then nothing can be taken back. The caller keeps
// ownership.
Journal* CurrentJournal();
void SetJournal(Journal* journal);
