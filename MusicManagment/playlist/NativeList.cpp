#include <array>

#include "CommonRUKTools/CodePage.h"
#include "MusicManagment/database/tsdb/PackedRecord.h"
#include "MusicManagment/playlist/ListBuilder.h"
#include "MusicManagment/playlist/PlayListFiles.h"

// The program's own lists (.rukpl): names as they are listed, each with the record of its song.

using namespace Qt::StringLiterals;

namespace {

constexpr std::uint16_t kVersion = 0x0100;
constexpr std::uint8_t kWithRecord = 255;
constexpr std::uint8_t kWithoutRecord = 0;
constexpr qsizetype kLongestText = 65'535;  // bytes; the length is a 16-bit number

using TextField = QString TID3Tag::*;
constexpr std::array<TextField, 6> kTexts = {&TID3Tag::FileName, &TID3Tag::Title,   &TID3Tag::Artist,
                                             &TID3Tag::Album,    &TID3Tag::Comment, &TID3Tag::MPEGLayer};

// The converter takes a byte-order mark at the head away; within a record it is a character like any other.
QString ReadText(ByteReader& reader) {
    const std::size_t length = reader.U16Le();
    const ByteSpan bytes = reader.Take(length);
    QString text = CodePage::FromSystem(bytes);
    if (StartsWith(bytes, "\xEF\xBB\xBF") && CodePage::IsValidUtf8(bytes)) text.prepend(QChar::ByteOrderMark);
    return text;
}

TID3Tag ReadRecord(ByteReader& reader) {
    TID3Tag record;
    record.Year = QString::number(ReadPackedRecord(reader, record));
    for (const TextField text : kTexts)
        record.*text = ReadText(reader);
    return record;
}

[[noreturn]] void ThrowDamaged(std::size_t entry) {
    throw EPlayListException(u"Diese PlayList ist beschädigt (Eintrag %1)."_s.arg(entry + 1));
}

PlayListEntry ReadEntry(ByteReader& reader, std::size_t number) {
    PlayListEntry entry{.Name = ReadText(reader)};
    const std::uint8_t flag = reader.U8();
    if (flag == kWithRecord)
        entry.Record = ReadRecord(reader);
    else if (flag != kWithoutRecord)
        ThrowDamaged(number);
    if (reader.Failed()) ThrowDamaged(number);
    return entry;
}

void WriteText(ByteWriter& file, const QString& text) {
    const QByteArray bytes = CodePage::CutSystem(CodePage::ToSystem(text), kLongestText);
    file.U16Le(static_cast<std::uint16_t>(bytes.size()));
    file.Raw(AllOf(bytes));
}

}  // namespace

std::vector<PlayListEntry> ParseNativeList(ByteSpan contents) {
    ByteReader reader(contents);
    if (reader.U16Le() != kVersion || reader.Failed())
        throw EUnknownPlayListVersion(u"Diese PlayList liegt in einer unbekannten Version vor."_s);
    ListBuilder list;
    while (!reader.AtEnd())
        list.Add(ReadEntry(reader, list.Count()));
    return list.Take();
}

void WriteNativeList(ByteWriter& file, std::span<const EntryToSave> entries) {
    file.Raw("RUKPLYLST");
    file.U16Le(kVersion);
    for (const EntryToSave& saved : entries) {
        const PlayListEntry& entry = *saved.Entry;
        WriteText(file, entry.Name);
        file.U8(entry.Record ? kWithRecord : kWithoutRecord);
        if (!entry.Record) continue;
        file.Raw(PackedRecord(*entry.Record));
        for (const TextField text : kTexts)
            WriteText(file, *entry.Record.*text);
    }
}
