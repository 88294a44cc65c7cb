#include "MusicManagment/database/journal/JournalFile.h"

#include <zlib.h>

#include <QDir>
#include <algorithm>

#include "CommonRUKTools/BufferedSource.h"
#include "CommonRUKTools/SafeFile.h"

using namespace Qt::StringLiterals;

namespace {

constexpr std::string_view kMagic{"TSJRNL\x01\x00", 8};

// docs/formats.md describes the frames.
enum : quint8 { kBegin = 1, kStep = 2, kOutcome = 3, kFinish = 4 };
constexpr std::size_t kFrameHeader = 24;
constexpr std::size_t kSummedHeader = 20;
constexpr std::size_t kLongestHead = std::size_t{1} << 26;
constexpr std::size_t kOutcomeHead = 12;
constexpr std::size_t kOutcomeEntry = 38;

quint32 SumOf(ByteSpan bytes, quint32 before = 0) {
    return static_cast<quint32>(crc32_z(before, bytes.data(), bytes.size()));
}

struct Frame {
    quint8 Kind = 0;
    std::vector<std::uint8_t> Head{};
    qint64 BodyAt = 0;
    qint64 BodySize = 0;
    quint32 BodySum = 0;
    qint64 End = 0;
};

// Nothing where no whole frame stands.
std::optional<Frame> ReadFrame(ByteSource& file, qint64 at) {
    if (file.Size() - at < static_cast<qint64>(kFrameHeader)) return std::nullopt;
    const auto header = file.ReadExactly(at, kFrameHeader);
    ByteReader reader(header);
    Frame frame;
    frame.Kind = reader.U8();
    reader.Skip(3);
    const std::size_t headSize = reader.U32Le();
    const quint64 bodySize = reader.U64Le();
    frame.BodySum = reader.U32Le();
    const quint32 sum = reader.U32Le();

    const auto left = static_cast<quint64>(file.Size() - at) - kFrameHeader;
    if (headSize > kLongestHead || headSize > left || bodySize > left - headSize) return std::nullopt;
    frame.Head = file.ReadExactly(at + static_cast<qint64>(kFrameHeader), headSize);
    if (SumOf(frame.Head, SumOf(ByteSpan(header).first(kSummedHeader))) != sum) return std::nullopt;
    frame.BodyAt = at + static_cast<qint64>(kFrameHeader + headSize);
    frame.BodySize = static_cast<qint64>(bodySize);
    frame.End = frame.BodyAt + frame.BodySize;
    return frame;
}

// --- What the frames say ---

bool TakeBegin(ByteReader& head, qint64 at, JournalContents& contents) {
    StoredBatch batch;
    batch.From = at;
    batch.Header.Id = head.U64Le();
    const quint8 kind = head.U8();
    batch.Header.Kind = static_cast<BatchKind>(kind);
    batch.Header.Of = head.U64Le();
    batch.Header.Time = static_cast<qint64>(head.U64Le());
    batch.Header.Caption = ReadText(head);
    batch.Header.Database = ReadText(head);
    if (head.Failed() || kind > static_cast<quint8>(BatchKind::Redo)) return false;
    contents.Batches.push_back(std::move(batch));
    return true;
}

bool TakeStep(ByteReader& head, const Frame& frame, JournalContents& contents) {
    if (contents.Batches.empty() || contents.Batches.back().IsFinished) return false;
    auto step = ReadHead(head);
    if (!step) return false;
    contents.Batches.back().Steps.push_back({.Head = std::move(*step),
                                             .BodyAt = frame.BodyAt,
                                             .BodySize = frame.BodySize,
                                             .BodySum = frame.BodySum});
    return true;
}

bool TakeOutcome(ByteReader& head, JournalContents& contents) {
    StoredBatch* batch = contents.Find(head.U64Le());
    const quint32 count = head.U32Le();
    for (quint32 i = 0; i < count && !head.Failed(); ++i) {
        const quint32 number = head.U32Le();
        const quint8 outcome = head.U8();
        const FileState after = ReadState(head);
        if (outcome > static_cast<quint8>(StepOutcome::Open)) return false;
        if (head.Failed() || batch == nullptr || number >= batch->Steps.size()) continue;
        batch->Steps[number].Outcome = static_cast<StepOutcome>(outcome);
        batch->Steps[number].Head.After = after;
    }
    return !head.Failed();
}

bool TakeFinish(ByteReader& head, JournalContents& contents) {
    StoredBatch* batch = contents.Find(head.U64Le());
    const auto time = static_cast<qint64>(head.U64Le());
    const bool dropsRest = head.U8() != 0;
    const QString caption = ReadText(head);
    if (head.Failed()) return false;
    if (batch == nullptr) return true;  // one that was dropped
    batch->IsFinished = true;
    batch->FinishedNs = time;
    batch->DropsRest = dropsRest;
    if (!caption.isEmpty()) batch->Header.Caption = caption;
    return true;
}

bool TakeFrame(const Frame& frame, qint64 at, JournalContents& contents) {
    ByteReader head(frame.Head);
    switch (frame.Kind) {
        case kBegin:
            return TakeBegin(head, at, contents);
        case kStep:
            return TakeStep(head, frame, contents);
        case kOutcome:
            return TakeOutcome(head, contents);
        case kFinish:
            return TakeFinish(head, contents);
        default:
            return false;
    }
}

}  // namespace

StoredBatch* JournalContents::Find(quint64 id) {
    const auto batch = std::ranges::find(Batches.rbegin(), Batches.rend(), id,
                                         [](const StoredBatch& b) { return b.Header.Id; });
    return batch != Batches.rend() ? &*batch : nullptr;
}

JournalContents ReadJournal(ByteSource& file) {
    JournalContents contents;
    if (file.Size() == 0) return contents;
    BufferedSource buffered(file);  // in small pieces: between two heads there may be a picture
    const auto magic =
        buffered.ReadExactly(0, std::min<std::size_t>(kMagic.size(), static_cast<std::size_t>(file.Size())));
    contents.IsOurs = std::ranges::equal(magic, AsBytes(kMagic));
    if (!contents.IsOurs) {
        // Torn when it was made.
        contents.IsOurs = std::ranges::equal(magic, AsBytes(kMagic.substr(0, magic.size())));
        return contents;
    }
    contents.End = static_cast<qint64>(kMagic.size());
    while (const auto frame = ReadFrame(buffered, contents.End)) {
        if (!TakeFrame(*frame, contents.End, contents)) break;
        contents.End = frame->End;
    }
    return contents;
}

std::optional<JournalStep> LoadStep(ByteSource& file, const StoredBatch::Step& step) {
    JournalStep loaded = step.Head;
    const auto body = file.ReadExactly(step.BodyAt, static_cast<std::size_t>(step.BodySize));
    ByteReader reader(body);
    if (SumOf(body) != step.BodySum || !ReadBody(reader, loaded)) return std::nullopt;
    return loaded;
}

// --- Writing ---

namespace {

std::unique_ptr<FileLock> LockOf(const QString& path) {
    auto lock = std::make_unique<FileLock>(path);
    if (lock->IsTaken()) return lock;
    throw EJournalBusy(lock->Holder() + u" ändert gerade Dateien. Warten Sie, bis das beendet ist."_s);
}

JournalContents ContentsOf(const QString& path) {
    const auto file = FileSource::TryOpen(path);
    return file ? ReadJournal(*file) : JournalContents();
}

}  // namespace

JournalFile::JournalFile(const QString& path)
    : path_(path), lock_(LockOf(path)), contents_(ContentsOf(path)) {
    if (!contents_.IsOurs) throw EStreamError(u"Das ist kein Journal und wird nicht verändert: "_s + path);
}

// The room that was kept for an outcome is not needed any more.
JournalFile::~JournalFile() {
    try {
        if (file_ && file_->Look().State.Size > contents_.End) file_->Resize(contents_.End);
    } catch (const EStreamError&) {
        // It is no frame and will be written over.
    }
}

std::optional<JournalStep> JournalFile::Load(const StoredBatch::Step& step) const {
    FileSource file(path_);
    return LoadStep(file, step);
}

quint64 JournalFile::NextId() const {
    quint64 last = 0;
    for (const StoredBatch& batch : contents_.Batches)
        last = std::max(last, batch.Header.Id);
    return last + 1;
}

void JournalFile::AddFrame(quint8 kind, const ByteWriter& head, const ByteWriter& body) {
    ByteWriter header;
    header.U8(kind);
    header.Zeros(3);
    header.U32Le(static_cast<quint32>(head.Size()));
    header.U64Le(body.Size());
    header.U32Le(SumOf(body.Bytes()));
    header.U32Le(SumOf(head.Bytes(), SumOf(header.Bytes())));
    pending_.Raw(header.Bytes());
    pending_.Raw(head.Bytes());
    pending_.Raw(body.Bytes());
}

void JournalFile::AddBegin(const BatchHeader& header) {
    ByteWriter head;
    head.U64Le(header.Id);
    head.U8(static_cast<quint8>(header.Kind));
    head.U64Le(header.Of);
    head.U64Le(static_cast<quint64>(header.Time));
    WriteText(head, header.Caption);
    WriteText(head, header.Database);
    AddFrame(kBegin, head, {});
}

void JournalFile::AddStep(const JournalStep& step) {
    ByteWriter head;
    ByteWriter body;
    WriteHead(head, step);
    WriteBody(body, step);
    AddFrame(kStep, head, body);
}

void JournalFile::AddOutcome(quint64 batch, const std::vector<OutcomeOf>& steps) {
    ByteWriter head;
    head.U64Le(batch);
    head.U32Le(static_cast<quint32>(steps.size()));
    for (const OutcomeOf& step : steps) {
        head.U32Le(step.Step);
        head.U8(static_cast<quint8>(step.Outcome));
        WriteState(head, step.After);
    }
    AddFrame(kOutcome, head, {});
}

void JournalFile::AddFinish(quint64 batch, bool dropsRest, const QString& caption) {
    ByteWriter head;
    head.U64Le(batch);
    head.U64Le(static_cast<quint64>(FileTimeNow()));
    head.U8(dropsRest ? 1 : 0);
    WriteText(head, caption);
    AddFrame(kFinish, head, {});
}

// Made where it is missing; what lies behind the last whole frame goes.
void JournalFile::Open() {
    if (file_) return;
    if (FileSource::Exists(path_)) {
        file_ = std::make_unique<WorkFile>(WorkFile::Existing(path_, FileCalls::Access::Change));
        if (file_->Look().State.Size > contents_.End) file_->Resize(contents_.End);
    } else {
        QDir().mkpath(FolderOfFile(path_));
        file_ = std::make_unique<WorkFile>(WorkFile::New(path_));
    }
    if (contents_.End == 0) {
        file_->Write(0, AsBytes(kMagic));
        contents_.End = static_cast<qint64>(kMagic.size());
        FlushFiles({path_});
    }
}

void JournalFile::Write(std::size_t stepsToCome) {
    const std::size_t size = pending_.Size();
    if (stepsToCome > 0) pending_.Zeros(kFrameHeader + kOutcomeHead + stepsToCome * kOutcomeEntry);
    writing_.Clear();
    std::swap(writing_, pending_);
    Open();
    if (hasTornTail_) file_->Resize(contents_.End);
    // What stays behind the end may hold whole frames; it must not be joined to those that come.
    hasTornTail_ = true;
    file_->Write(contents_.End, writing_.Bytes());
    hasTornTail_ = false;
    contents_.End += static_cast<qint64>(size);
}

void JournalFile::Flush() {
    if (file_) file_->Flush();
}

void JournalFile::DropBefore(std::size_t batch) {
    const auto& batches = contents_.Batches;
    if (batch == 0 || batches.empty()) return;
    const qint64 from = batch < batches.size() ? batches[batch].From : contents_.End;
    {
        FileSource old(path_);
        SafeFile kept(path_);
        kept.Write(AsBytes(kMagic));
        constexpr qint64 kPiece = 1 << 20;
        for (qint64 at = from; at < contents_.End; at += kPiece)
            kept.Write(old.ReadExactly(at, static_cast<std::size_t>(std::min(kPiece, contents_.End - at))));
        kept.Commit();
    }
    file_.reset();
    contents_ = ContentsOf(path_);
}
