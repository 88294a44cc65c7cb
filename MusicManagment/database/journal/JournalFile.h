#pragma once

#include <QString>
#include <memory>
#include <optional>
#include <vector>

#include "CommonRUKTools/FileLock.h"
#include "CommonRUKTools/FileWork.h"
#include "MusicManagment/database/journal/JournalStep.h"

// The numbers stand in the journal.
enum class BatchKind : quint8 { Change = 0, Undo = 1, Redo = 2 };

struct BatchHeader {
    quint64 Id = 0;
    BatchKind Kind = BatchKind::Change;
    quint64 Of = 0;   // the batch that it takes back
    qint64 Time = 0;  // milliseconds since 1970, UTC
    QString Caption{};
    QString Database{};  // path of the one whose songs it is about; empty for files alone
};

// A batch as it stands in the file.
struct StoredBatch {
    struct Step {
        JournalStep Head{};
        StepOutcome Outcome = StepOutcome::None;
        qint64 BodyAt = 0;
        qint64 BodySize = 0;
        quint32 BodySum = 0;
    };

    BatchHeader Header{};
    std::vector<Step> Steps{};
    bool IsFinished = false;
    bool DropsRest = false;  // what it has not taken back is not to be taken back any more
    qint64 FinishedNs = 0;   // since 1970, by the clock of the file system
    qint64 From = 0;         // place in the file
};

struct JournalContents {
    std::vector<StoredBatch> Batches{};
    qint64 End = 0;      // behind the last frame that is whole
    bool IsOurs = true;  // not when the file begins with something else

    StoredBatch* Find(quint64 id);
};

// Understands as much of the journal as is whole; a torn tail is nothing. Any bytes will do.
JournalContents ReadJournal(ByteSource& file);
// The whole step; nothing when its body is damaged.
std::optional<JournalStep> LoadStep(ByteSource& file, const StoredBatch::Step& step);

// What became of a step, as a frame tells it.
struct OutcomeOf {
    quint32 Step = 0;
    StepOutcome Outcome = StepOutcome::None;
    FileState After{};
};

// Another program has the journal: it changes files now.
class EJournalBusy : public ERukException {
 public:
    using ERukException::ERukException;
};

// The journal in the hands of the one who may write it, as long as this object lives.
class JournalFile {
 public:
    // Throws EJournalBusy, or EStreamError when it cannot be read.
    explicit JournalFile(const QString& path);
    ~JournalFile();
    JournalFile(const JournalFile&) = delete;
    JournalFile& operator=(const JournalFile&) = delete;

    const JournalContents& Contents() const { return contents_; }
    JournalContents& EditContents() { return contents_; }
    std::optional<JournalStep> Load(const StoredBatch::Step& step) const;
    quint64 NextId() const;

    // Frames are collected and written together. What cannot be written is forgotten.
    void AddBegin(const BatchHeader& header);
    void AddStep(const JournalStep& step);
    void AddOutcome(quint64 batch, const std::vector<OutcomeOf>& steps);
    void AddFinish(quint64 batch, bool dropsRest, const QString& caption);
    // Writes them, with room behind for an outcome of so many steps, which then cannot fail for want of it.
    // Throws EStreamError.
    void Write(std::size_t stepsToCome = 0);
    void Flush();

    // Keeps the batches from this one on. Throws EStreamError; the file is then as it was.
    void DropBefore(std::size_t batch);

 private:
    void Open();
    void AddFrame(quint8 kind, const ByteWriter& head, const ByteWriter& body);

    QString path_;
    std::unique_ptr<FileLock> lock_;
    JournalContents contents_;
    std::unique_ptr<WorkFile> file_;
    ByteWriter pending_;
    ByteWriter writing_;        // takes turns with it: memory of this size is costly to get
    bool hasTornTail_ = false;  // a write has failed in its middle
};
