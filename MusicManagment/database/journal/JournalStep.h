#pragma once

#include <QString>
#include <QStringList>
#include <optional>
#include <vector>

#include "CommonRUKTools/ByteWriter.h"
#include "CommonRUKTools/FileChange.h"
#include "ReadMPEGHeader/ID3Tag.h"

// The numbers of the kinds and outcomes stand in the journal.
enum class StepKind : quint8 {
    Patch = 1,    // a file gets a new version
    Move = 2,     // a file gets another path
    Trash = 3,    // a file goes into the recycle bin
    Untrash = 4,  // and comes back
    Record = 5,   // a song of the collection changes, comes or goes
    Ban = 6,      // an entry of the ban list comes or goes
};

enum class StepOutcome : quint8 {
    None = 0,  // announced, and nothing is known of it
    Done = 1,
    Failed = 2,  // nothing has changed
    TakenBack = 3,
    Open = 4,  // half done, and it could not be taken back so far
};

// Nothing before: the song comes. Nothing after: it goes.
struct RecordChange {
    std::optional<TID3Tag> Before{};
    std::optional<TID3Tag> After{};

    RecordChange Opposite() const { return {After, Before}; }
    bool operator==(const RecordChange&) const = default;
};

struct BanChange {
    QString Entry{};
    bool Added = false;

    BanChange Opposite() const { return {Entry, !Added}; }
    bool operator==(const BanChange&) const = default;
};

// One step of a batch with everything that brings back what was before it.
struct JournalStep {
    // --- The head, which is kept in memory ---
    StepKind Kind = StepKind::Record;
    quint32 Item = 0;       // steps of one item follow each other
    qint32 Takes = -1;      // the step of another batch that it takes back, by its number there
    QString Path{};         // of the file, before the step
    QString To{};           // Move: the new path; Trash and Untrash: the place in the bin
    QString Temporary{};    // under which a new version or a copy is built
    QStringList Folders{};  // that are made for it, outermost first
    QStringList Emptied{};  // that go after it where they are empty
    FileState Before{};
    FileState After{};  // what we left; before the outcome is known, what is planned

    // --- The body, which is read when it is needed ---
    FilePatch Inverse{};
    RecordChange Record{};
    BanChange Ban{};

    bool operator==(const JournalStep&) const = default;

    bool IsOfFile() const { return Kind <= StepKind::Untrash; }
    PatchPlan AsPatch() const;
    MovePlan AsMove() const;
};

void WriteState(ByteWriter& writer, const FileState& state);
FileState ReadState(ByteReader& reader);
void WriteText(ByteWriter& writer, const QString& text);
QString ReadText(ByteReader& reader);

void WriteHead(ByteWriter& writer, const JournalStep& step);
void WriteBody(ByteWriter& writer, const JournalStep& step);
// Nothing from bytes that are no step.
std::optional<JournalStep> ReadHead(ByteReader& reader);
// Fills the body of a step whose head is known; false when the bytes are none.
bool ReadBody(ByteReader& reader, JournalStep& step);
