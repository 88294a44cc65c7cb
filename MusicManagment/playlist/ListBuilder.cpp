#include "MusicManagment/playlist/ListBuilder.h"

using namespace Qt::StringLiterals;

namespace {

// What a text takes beside its characters: the head of its block and the memory manager's own.
constexpr std::size_t kTextOverhead = 32;

std::size_t MemoryOf(const QString& text) {
    return text.isEmpty() ? 0 : kTextOverhead + sizeof(QChar) * static_cast<std::size_t>(text.size());
}

std::size_t MemoryOf(const PlayListEntry& entry) {
    std::size_t bytes = sizeof(PlayListEntry) + MemoryOf(entry.Name);
    if (!entry.Record) return bytes;
    const TID3Tag& record = *entry.Record;
    bytes += sizeof(TID3Tag);
    for (const QString* text :
         {&record.Title, &record.Artist, &record.Album, &record.Year, &record.Comment, &record.MPEGLayer})
        bytes += MemoryOf(*text);
    // Nearly always the same text as the name.
    return record.FileName.constData() == entry.Name.constData() ? bytes : bytes + MemoryOf(record.FileName);
}

}  // namespace

void ListBuilder::Add(PlayListEntry entry) {
    memory_ += MemoryOf(entry);
    if (entries_.size() >= kMostListEntries || memory_ > kMostListMemory) ThrowListTooLarge();
    entries_.push_back(std::move(entry));
}

void ThrowListTooLarge() {
    throw EPlayListException(u"Diese PlayList ist zu groß."_s);
}
