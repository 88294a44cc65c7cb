#include "MusicManagment/database/journal/Journal.h"

#include <QFileInfo>
#include <QSet>
#include <algorithm>

#include "CommonRUKTools/AbsolutePath.h"
#include "CommonRUKTools/FileSource.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/journal/JournalLists.h"

using namespace Qt::StringLiterals;

namespace {

// What a batch needs beside its old bytes: frames, names, and room for others on a disk that is nearly full.
constexpr qint64 kRoomBeside = qint64{16} << 20;

BatchInfo InfoOf(const RestOfBatch& rest) {
    const BatchHeader& header = rest.Batch->Header;
    BatchInfo info{
        .Id = header.Id, .Time = header.Time, .Caption = header.Caption, .Database = header.Database};
    QSet<quint32> items;
    for (const quint32 number : rest.Steps) {
        const JournalStep& step = rest.Batch->Steps[number].Head;
        if (step.IsOfFile()) items.insert(step.Item);
        info.NeedsDatabase = info.NeedsDatabase || !step.IsOfFile();
    }
    info.Steps = static_cast<int>(rest.Steps.size());
    info.Files = static_cast<int>(items.size());
    return info;
}

std::vector<BatchInfo> InfosOf(const std::vector<RestOfBatch>& list) {
    std::vector<BatchInfo> infos;
    infos.reserve(list.size());
    for (const RestOfBatch& rest : list)
        infos.push_back(InfoOf(rest));
    return infos;
}

std::optional<BatchInfo> LastOf(const std::vector<BatchInfo>& list) {
    return list.empty() ? std::nullopt : std::optional(list.back());
}

Journal* journalInUse = nullptr;

}  // namespace

Journal* CurrentJournal() {
    return journalInUse;
}

void SetJournal(Journal* journal) {
    journalInUse = journal;
}

EOtherDatabase::EOtherDatabase(const QString& database)
    : ERukException(u"Der letzte Schritt gehört zu einer anderen Datenbank: "_s +
                    (database.isEmpty() ? u"(noch nicht gespeichert)"_s : database)),
      database_(database) {}

Journal::Journal(QString path, JournalLimits limits) : path_(std::move(path)), limits_(limits) {}

const JournalContents& Journal::Contents() const {
    const FileState now = StateOf(path_);
    if (now.Exists() ? now.IsStill(read_) : contents_.Batches.empty()) return contents_;
    const auto file = FileSource::TryOpen(path_);
    contents_ = file ? ReadJournal(*file) : JournalContents();
    read_ = now;
    const JournalLists lists = ListsOf(contents_);
    toUndo_ = InfosOf(lists.ToUndo);
    toRedo_ = InfosOf(lists.ToRedo);
    return contents_;
}

std::vector<BatchInfo> Journal::Batches() const {
    Contents();
    return {toUndo_.rbegin(), toUndo_.rend()};
}

std::optional<BatchInfo> Journal::ToUndo() const {
    Contents();
    return LastOf(toUndo_);
}

std::optional<BatchInfo> Journal::ToRedo() const {
    Contents();
    return LastOf(toRedo_);
}

bool BatchInfo::IsFor(const TMusicDatabase& database) const {
    return !NeedsDatabase || IsSameDatabase(database, Database);
}

bool Journal::FitsBatch(qint64 bytes) const {
    if (bytes > limits_.Bytes) return false;
    const qint64 free = FreeBytes(QFileInfo(path_).absolutePath());
    return free < 0 || bytes + kRoomBeside <= free;
}

std::unique_ptr<JournalFile> Journal::OpenForBatch() {
    auto file = Open();
    DropOldest(*file, limits_);
    return file;
}

std::unique_ptr<JournalFile> Journal::Open() {
    auto file = std::make_unique<JournalFile>(path_);
    const RecoveryResult recovered = Recover(*file);
    if (!recovered.IsEmpty() && OnTakenBack) OnTakenBack(recovered);
    return file;
}

RecoveryResult Journal::TakeBackUnfinished() {
    if (!HasUnfinished(Contents())) return {};
    try {
        JournalFile file(path_);
        RecoveryResult result = Recover(file);
        Changed.Tell();
        return result;
    } catch (const EJournalBusy&) {
        return {};  // it is being done
    }
}

// --- What was found at the start ---

QString RecoveryResult::Message() const {
    QString message;
    if (!TakenBack.isEmpty())
        message = u"Das Ändern von Dateien ("_s + Caption +
                  u") wurde unterbrochen. Diese Dateien sind wieder, wie sie vorher waren:\n"_s +
                  TakenBack.join(u'\n');
    if (Problems.isEmpty()) return message;
    if (!message.isEmpty()) message += u"\n\n"_s;
    return message + u"Diese Dateien konnten nicht wiederhergestellt werden:\n"_s + Problems.join(u'\n');
}

// --- A database that was not saved in time ---

namespace {

// Songs that come or go with their files do so; the others have only come or gone in the collection that was
// not saved.
bool AgreesWithDisk(const RecordChange& change) {
    if (change.Before && change.After) return true;
    return change.After ? FileSource::Exists(change.After->FileName)
                        : !FileSource::Exists(change.Before->FileName);
}

}  // namespace

int Journal::BringUpToDate(TMusicDatabase& database) const {
    const QString path = AbsolutePath(database.FileName());
    const FileState saved = StateOf(path);
    if (!saved.Exists()) return 0;
    std::vector<RecordChange> records;
    std::vector<BanChange> bans;
    for (const StoredBatch& batch : Contents().Batches) {
        const bool wasSaved = batch.IsFinished && batch.FinishedNs <= saved.ModifiedNs;
        if (wasSaved || batch.Header.Database != path) continue;
        FileSource file(path_);
        for (const StoredBatch::Step& step : batch.Steps) {
            if (step.Outcome != StepOutcome::Done || step.Head.IsOfFile()) continue;
            const auto loaded = LoadStep(file, step);
            if (!loaded) continue;
            if (loaded->Kind == StepKind::Ban)
                bans.push_back(loaded->Ban);
            else if (AgreesWithDisk(loaded->Record))
                records.push_back(loaded->Record);
        }
    }
    if (ApplyBans(database, bans)) database.Events().BannListChanged.Tell();
    return records.empty() ? 0
                           : static_cast<int>(ApplyRecords(database, records, Applying::Again).Songs.size());
}

bool IsSameDatabase(const TMusicDatabase& database, const QString& path) {
    return AbsolutePath(database.FileName()) == path;
}
