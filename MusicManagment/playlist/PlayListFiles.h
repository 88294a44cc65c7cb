#pragma once

#include <QByteArray>
#include <QString>
#include <span>
#include <string_view>
#include <vector>

#include "CommonRUKTools/ByteReader.h"
#include "CommonRUKTools/ByteWriter.h"
#include "MusicManagment/playlist/PlayListTypes.h"

// Lists in files. Each format has a source of its own.

// The file is of a version of the native format that is not known.
class EUnknownPlayListVersion : public EPlayListException {
 public:
    using EPlayListException::EPlayListException;
};

// Reads a list of any format; which it is is known by the first bytes. Throws EStreamError when the file
// cannot be read, EPlayListException when it is damaged or too large.
std::vector<PlayListEntry> ReadPlayList(const QString& fileName);
std::vector<PlayListEntry> ParsePlayList(ByteSpan file);

// An entry on its way into a file.
struct EntryToSave {
    const PlayListEntry* Entry;
    QString Path;  // where the song is now; empty leaves it out, but not in the native format
};

// Writes a list in the format that the name's extension stands for. Throws EStreamError; the old file is then
// as it was.
void WritePlayList(const QString& fileName, std::span<const EntryToSave> entries);

// All bytes of a text; the implicit conversion would end at the first zero byte.
inline std::string_view AllOf(const QByteArray& text) {
    return {text.constData(), static_cast<std::size_t>(text.size())};
}

// --- The formats ---

// Throws EPlayListException.
std::vector<PlayListEntry> ParseNativeList(ByteSpan contents);
std::vector<PlayListEntry> ParseM3uList(ByteSpan contents);
std::vector<PlayListEntry> ParsePlsList(ByteSpan contents);
std::vector<PlayListEntry> ParsePlainList(ByteSpan contents);

void WriteNativeList(ByteWriter& file, std::span<const EntryToSave> entries);
void WriteM3uList(ByteWriter& file, std::span<const EntryToSave> entries);
void WritePlsList(ByteWriter& file, std::span<const EntryToSave> entries);
void WritePlainList(ByteWriter& file, std::span<const EntryToSave> entries);

// The most entries that a file may have: enough for every collection, and little enough for memory when a
// hostile file holds nothing but tiny ones.
inline constexpr std::size_t kMostListEntries = 2'000'000;
// Appends an entry. Throws EPlayListException when the list has too many.
void AppendEntry(std::vector<PlayListEntry>& entries, PlayListEntry entry);
