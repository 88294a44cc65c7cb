#pragma once

#include <QByteArray>
#include <QString>
#include <span>
#include <string_view>
#include <vector>

#include "CommonRUKTools/ByteReader.h"
#include "CommonRUKTools/ByteWriter.h"
#include "MusicManagment/playlist/ListRules.h"
#include "MusicManagment/playlist/PlayListTypes.h"

// Lists in files. Each format has a source of its own.

// The file is of a version of the native format that is not known.
class EUnknownPlayListVersion : public EPlayListException {
 public:
    using EPlayListException::EPlayListException;
};

// Reads a list of any format. Throws EStreamError when the file cannot be read, EPlayListException when it is
// damaged or too large.
std::vector<PlayListEntry> ReadPlayList(const ListRules& rules, const ListOrigin& origin);

// An entry on its way into a file.
struct EntryToSave {
    const PlayListEntry* Entry;
    QString Path;  // where the song is now; empty leaves it out, but not in the native format
};

// Throws EStreamError; the old file is then as it was.
void WritePlayList(const QString& fileName, PlayListFormat format, std::span<const EntryToSave> entries);

// All bytes of a text; the implicit conversion would end at the first zero byte.
inline std::string_view AllOf(const QByteArray& text) {
    return {text.constData(), static_cast<std::size_t>(text.size())};
}

// --- The formats ---

// What stands before the remark of a song in M3U lists.
inline constexpr std::string_view kM3uRemark = "#EXTINF:";

// Each throws EPlayListException. Relative names are made absolute against `folder`.
std::vector<PlayListEntry> ParseNativeList(ByteSpan contents);
std::vector<PlayListEntry> ParseM3uList(ByteSpan contents, const QString& folder);
std::vector<PlayListEntry> ParsePlsList(ByteSpan contents, const QString& folder);
std::vector<PlayListEntry> ParsePlainList(ByteSpan contents, const QString& folder);

void WriteNativeList(ByteWriter& file, std::span<const EntryToSave> entries);
void WriteM3uList(ByteWriter& file, std::span<const EntryToSave> entries);
void WriteM3u8List(ByteWriter& file, std::span<const EntryToSave> entries);
void WritePlsList(ByteWriter& file, std::span<const EntryToSave> entries);
void WritePlainList(ByteWriter& file, std::span<const EntryToSave> entries);
