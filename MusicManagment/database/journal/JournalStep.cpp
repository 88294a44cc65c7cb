#include "MusicManagment/database/journal/JournalStep.h"

#include <QtEndian>
#include <algorithm>
#include <string_view>
#include <type_traits>

#include "MusicManagment/database/SongFields.h"

PatchPlan JournalStep::AsPatch() const {
    return {.Path = Path, .Before = Before, .After = After, .Inverse = Inverse, .Temporary = Temporary};
}

MovePlan JournalStep::AsMove() const {
    return {.From = Path,
            .To = To,
            .Before = Before,
            .Folders = Folders,
            .Emptied = Emptied,
            .Temporary = Temporary};
}

// --- Small things ---

void WriteState(ByteWriter& writer, const FileState& state) {
    writer.U64Le(static_cast<quint64>(state.Size));
    writer.U64Le(static_cast<quint64>(state.ModifiedNs));
    writer.U64Le(state.Device);
    writer.U64Le(state.Inode);
    writer.U8(state.ReadOnly ? 1 : 0);
}

FileState ReadState(ByteReader& reader) {
    FileState state;
    state.Size = static_cast<qint64>(reader.U64Le());
    state.ModifiedNs = static_cast<qint64>(reader.U64Le());
    state.Device = reader.U64Le();
    state.Inode = reader.U64Le();
    state.ReadOnly = reader.U8() != 0;
    return state;
}

// UTF-16, because a path may hold what is no valid text.
void WriteText(ByteWriter& writer, const QString& text) {
    writer.U32Le(static_cast<quint32>(text.size()));
    if (text.isEmpty()) return;  // nor has the vector bytes that could be named
    std::vector<std::uint8_t> units(2 * static_cast<std::size_t>(text.size()));
    qToLittleEndian<char16_t>(text.utf16(), text.size(), units.data());
    writer.Raw(units);
}

QString ReadText(ByteReader& reader) {
    const quint32 size = reader.U32Le();
    if (size > reader.Remaining() / 2) {
        reader.Take(reader.Remaining() + 1);
        return {};
    }
    QString text(static_cast<qsizetype>(size), Qt::Uninitialized);
    for (QChar& c : text)
        c = QChar(reader.U16Le());
    return text;
}

namespace {

void WriteTexts(ByteWriter& writer, const QStringList& texts) {
    writer.U32Le(static_cast<quint32>(texts.size()));
    for (const QString& text : texts)
        WriteText(writer, text);
}

QStringList ReadTexts(ByteReader& reader) {
    QStringList texts;
    const quint32 count = reader.U32Le();
    for (quint32 i = 0; i < count && !reader.Failed(); ++i)
        texts << ReadText(reader);
    return texts;
}

// --- Records: those members that differ from another record, each with its name, so that members to come
// make no difference ---

void WriteValue(ByteWriter& writer, const QString& value) {
    WriteText(writer, value);
}

template <typename Number>
void WriteValue(ByteWriter& writer, Number value) {
    if constexpr (std::is_same_v<Number, double>)
        writer.F64Le(value);
    else
        writer.U64Le(value);
}

void ReadValue(ByteReader& reader, QString& value) {
    value = ReadText(reader);
}

template <typename Number>
void ReadValue(ByteReader& reader, Number& value) {
    if constexpr (std::is_same_v<Number, double>)
        value = reader.F64Le();
    else
        value = static_cast<Number>(reader.U64Le());
}

void WriteRecord(ByteWriter& writer, const TID3Tag& record, const TID3Tag& base) {
    ByteWriter members;
    quint8 count = 0;
    for (const RecordMember& member : RecordMembers())
        std::visit(
            [&](auto field) {
                if (record.*field == base.*field) return;
                const std::string_view name(member.Name);
                members.U8(static_cast<quint8>(name.size()));
                members.Raw(name);
                WriteValue(members, record.*field);
                ++count;
            },
            member.Member);
    writer.U8(count);
    writer.Raw(members.Bytes());
}

bool ReadRecord(ByteReader& reader, TID3Tag& record) {
    const int count = reader.U8();
    for (int i = 0; i < count; ++i) {
        const ByteSpan bytes = reader.Take(reader.U8());
        const std::string_view name(reinterpret_cast<const char*>(bytes.data()), bytes.size());
        const auto members = RecordMembers();
        const auto member =
            std::ranges::find(members, name, [](const RecordMember& m) { return std::string_view(m.Name); });
        if (member == members.end()) return false;
        std::visit([&](auto field) { ReadValue(reader, record.*field); }, member->Member);
    }
    return !reader.Failed();
}

enum : quint8 { kHasBefore = 1, kHasAfter = 2 };

void WriteChange(ByteWriter& writer, const RecordChange& change) {
    const TID3Tag none;
    writer.U8(static_cast<quint8>((change.Before ? kHasBefore : 0) | (change.After ? kHasAfter : 0)));
    if (change.Before) WriteRecord(writer, *change.Before, none);
    if (change.After) WriteRecord(writer, *change.After, change.Before ? *change.Before : none);
}

bool ReadChange(ByteReader& reader, RecordChange& change) {
    const quint8 parts = reader.U8();
    if ((parts & kHasBefore) != 0 && !ReadRecord(reader, change.Before.emplace())) return false;
    if ((parts & kHasAfter) == 0) return true;
    change.After = change.Before ? *change.Before : TID3Tag();
    return ReadRecord(reader, *change.After);
}

}  // namespace

// --- Steps ---

void WriteHead(ByteWriter& writer, const JournalStep& step) {
    writer.U8(static_cast<quint8>(step.Kind));
    writer.U32Le(step.Item);
    writer.U32Le(static_cast<quint32>(step.Takes));
    if (!step.IsOfFile()) return;
    WriteText(writer, step.Path);
    WriteText(writer, step.To);
    WriteText(writer, step.Temporary);
    WriteTexts(writer, step.Folders);
    WriteTexts(writer, step.Emptied);
    WriteState(writer, step.Before);
    WriteState(writer, step.After);
}

std::optional<JournalStep> ReadHead(ByteReader& reader) {
    JournalStep step;
    const quint8 kind = reader.U8();
    if (kind < static_cast<quint8>(StepKind::Patch) || kind > static_cast<quint8>(StepKind::Ban))
        return std::nullopt;
    step.Kind = static_cast<StepKind>(kind);
    step.Item = reader.U32Le();
    step.Takes = static_cast<qint32>(reader.U32Le());
    if (step.IsOfFile()) {
        step.Path = ReadText(reader);
        step.To = ReadText(reader);
        step.Temporary = ReadText(reader);
        step.Folders = ReadTexts(reader);
        step.Emptied = ReadTexts(reader);
        step.Before = ReadState(reader);
        step.After = ReadState(reader);
    }
    if (reader.Failed() || !reader.AtEnd()) return std::nullopt;
    return step;
}

void WriteBody(ByteWriter& writer, const JournalStep& step) {
    if (step.Kind == StepKind::Patch) step.Inverse.Write(writer);
    if (step.Kind == StepKind::Record) WriteChange(writer, step.Record);
    if (step.Kind != StepKind::Ban) return;
    WriteText(writer, step.Ban.Entry);
    writer.U8(step.Ban.Added ? 1 : 0);
}

bool ReadBody(ByteReader& reader, JournalStep& step) {
    if (step.Kind == StepKind::Patch) {
        auto inverse = FilePatch::Read(reader);
        if (!inverse) return false;
        step.Inverse = std::move(*inverse);
    }
    if (step.Kind == StepKind::Record && !ReadChange(reader, step.Record)) return false;
    if (step.Kind == StepKind::Ban) {
        step.Ban.Entry = ReadText(reader);
        step.Ban.Added = reader.U8() != 0;
    }
    return !reader.Failed() && reader.AtEnd();
}
