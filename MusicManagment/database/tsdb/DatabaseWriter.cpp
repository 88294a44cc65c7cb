#include <algorithm>
#include <array>
#include <span>
#include <vector>

#include "CommonRUKTools/ByteWriter.h"
#include "CommonRUKTools/CodePage.h"
#include "MusicManagment/database/ListGuards.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/tsdb/DatabaseFile.h"
#include "MusicManagment/database/tsdb/DatabaseFormat.h"
#include "MusicManagment/database/tsdb/DeflateStream.h"
#include "MusicManagment/database/tsdb/PackedRecord.h"

using namespace Qt::StringLiterals;
using namespace DatabaseFormat;

namespace {

int ZlibLevel(int compression) {
    switch (compression) {
        case clDefault:
            return Z_DEFAULT_COMPRESSION;
        case clMax:
            return Z_BEST_COMPRESSION;
        default:
            return compression;
    }
}

// The bytes of the text of the song before: a text that many songs share mostly is that one, and the same in
// memory.
class RepeatingText {
 public:
    bool IsKnown(const QString& text) const {
        return text.constData() == text_.constData() && text.size() == text_.size();
    }
    void Set(const QString& text, ByteSpan bytes) {
        text_ = text;
        bytes_.assign(bytes.begin(), bytes.end());
    }
    ByteSpan Bytes() const { return bytes_; }

 private:
    QString text_;  // holds the characters, so that no other text can have their address
    std::vector<std::uint8_t> bytes_;
};

void StoreU32Le(std::uint32_t value, std::span<std::uint8_t> target) {
    for (std::size_t i = 0; i < 4; ++i)
        target[i] = static_cast<std::uint8_t>(value >> (8 * i));
}

class BodyWriter {
 public:
    BodyWriter(TMusicDatabase& database, SafeFile& file)
        : database_(database), stream_(file, ZlibLevel(database.Compression())) {}

    // False when the user stopped the run; what was written then is a valid body too.
    bool Write() {
        const bool finished = WriteUpdateFolders() && WriteLists() && WriteSongs();
        stream_.Finish();
        return finished;
    }
    int SongsWritten() const { return written_; }

 private:
    bool WriteUpdateFolders();
    bool WriteLists();
    bool WriteSongs();
    void WriteSong(const TID3Tag& song);

    ByteSpan WriteText(const QString& text);
    void WriteRepeating(const QString& text, RepeatingText& known);
    void WriteBlock(const QString& text, std::size_t size);
    void WriteNumber(int number) {
        StoreU32Le(static_cast<std::uint32_t>(number), stream_.Space(4));
        stream_.Add(4);
    }

    // Lets the interface work between rows; true when the user asked to stop.
    bool StoppedBetweenRows(int row) {
        if (row % kRowsPerTurn != 0) return false;
        return database_.Progress({.Cur = 0, .Max = database_.Count(), .Type = ptSaveDatabase}, false, false);
    }

    TMusicDatabase& database_;
    DeflateStream stream_;
    CodePage::SystemEncoder encoder_;
    std::array<RepeatingText, kSongTexts.size()> repeating_;
    int written_ = 0;
};

bool BodyWriter::WriteUpdateFolders() {
    const QStringList folders = database_.UpdateFolders();
    WriteNumber(static_cast<int>(folders.size()));
    for (const QString& folder : folders)
        WriteBlock(folder, kFolderBlock);
    return true;
}

bool BodyWriter::WriteLists() {
    const GroupLists& groups = database_.Groups();
    for (const auto& [type, block] : kGroupLists) {
        WriteNumber(groups.RowCount(type));
        for (int row = 0; row < groups.RowCount(type); ++row) {
            if (StoppedBetweenRows(row)) return false;
            WriteBlock(groups.RowCaption(type, row), block);
            WriteNumber(groups.RowSongCount(type, row));
        }
    }
    WriteNumber(kMainGenreCount);
    for (const int songs : groups.Genres())
        WriteNumber(songs);
    return true;
}

bool BodyWriter::WriteSongs() {
    const int count = database_.Count();
    for (const auto& song : database_.Songs()) {
        if (written_ % kSongsPerPoint == 0 &&
            database_.Progress({.Cur = written_, .Max = count, .Type = ptSaveDatabase}))
            return false;
        WriteSong(*song);
        ++written_;
    }
    return true;
}

void BodyWriter::WriteSong(const TID3Tag& song) {
    stream_.Write(PackedRecord(song));
    for (std::size_t i = 0; i < kSongTexts.size(); ++i) {
        const QString& text = song.*kSongTexts[i].Field;
        if (kSongTexts[i].Repeats)
            WriteRepeating(text, repeating_[i]);
        else
            WriteText(text);
    }
}

// Converts the text into the very bytes that are compressed next, and returns them.
ByteSpan BodyWriter::WriteText(const QString& text) {
    const auto space = stream_.Space(4 + encoder_.Space(text.size()));
    const auto converted = space.subspan(4, encoder_.Write(text, space.subspan(4)));
    const ByteSpan bytes = CodePage::CutSystem(ByteSpan(converted), kLongestText);
    StoreU32Le(static_cast<std::uint32_t>(bytes.size()), space);
    stream_.Add(4 + bytes.size());
    return bytes;
}

void BodyWriter::WriteRepeating(const QString& text, RepeatingText& known) {
    if (!known.IsKnown(text)) {
        known.Set(text, WriteText(text));
        return;
    }
    WriteNumber(static_cast<int>(known.Bytes().size()));
    stream_.Write(known.Bytes());
}

void BodyWriter::WriteBlock(const QString& text, std::size_t size) {
    const auto space = stream_.Space(std::max(size, encoder_.Space(text.size())));
    const auto converted = space.first(encoder_.Write(text, space));
    const std::size_t length = CodePage::CutSystem(ByteSpan(converted), size).size();
    std::fill(space.begin() + static_cast<std::ptrdiff_t>(length),
              space.begin() + static_cast<std::ptrdiff_t>(size), std::uint8_t{0});
    stream_.Add(size);
}

void WriteHeader(SafeFile& file, int songCount) {
    ByteWriter header;
    header.Raw(kMagic);
    header.U8(kVersion20 >> 8);
    header.U8(kVersion20 & 0xFF);
    header.U32Le(static_cast<std::uint32_t>(songCount));
    file.Write(header.Bytes());
}

void PatchSongCount(SafeFile& file, int songCount) {
    ByteWriter count;
    count.U32Le(static_cast<std::uint32_t>(songCount));
    file.Seek(kCountOffset);
    file.Write(count.Bytes());
}

bool WriteAll(TMusicDatabase& database, SafeFile& file) {
    const ProgressRun run(database, u"Erstelle Datenbank"_s);
    const BusyGuard busy(database);
    WriteHeader(file, database.Count());
    BodyWriter body(database, file);
    if (body.Write()) return true;
    PatchSongCount(file, body.SongsWritten());
    return false;
}

}  // namespace

bool WriteDatabase(TMusicDatabase& database, SafeFile& file) {
    if (!WriteAll(database, file)) return false;
    database.SetModified(false);
    return true;
}
