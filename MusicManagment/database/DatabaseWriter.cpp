#include "CommonRUKTools/ByteWriter.h"
#include "CommonRUKTools/CodePage.h"
#include "MusicManagment/database/DatabaseFile.h"
#include "MusicManagment/database/DatabaseFormat.h"
#include "MusicManagment/database/DeflateStream.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/PackedRecord.h"

using namespace Qt::StringLiterals;
using namespace DatabaseFormat;

namespace {

// Bytes that are gathered before they are compressed.
constexpr std::size_t kGathered = std::size_t{64} * 1024;

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

class BodyWriter {
 public:
    BodyWriter(TMusicDatabase& database, SafeFile& file)
        : database_(database), stream_(file, ZlibLevel(database.Compression())) {}

    // False when the user stopped the run; what was written then is a valid body too.
    bool Write() {
        const bool finished = WriteUpdateFolders() && WriteLists() && WriteSongs();
        Flush();
        stream_.Finish();
        return finished;
    }
    int SongsWritten() const { return written_; }

 private:
    bool WriteUpdateFolders();
    bool WriteLists();
    bool WriteSongs();
    void WriteSong(const TID3Tag& song);

    void WriteBlock(const QString& text, std::size_t size) {
        const QByteArray bytes = CodePage::CutSystem(CodePage::ToSystem(text), static_cast<qsizetype>(size));
        gathered_.Block({bytes.constData(), static_cast<std::size_t>(bytes.size())}, size);
        FlushWhenFull();
    }
    void WriteNumber(int number) { gathered_.U32Le(static_cast<std::uint32_t>(number)); }
    void FlushWhenFull() {
        if (gathered_.Size() >= kGathered) Flush();
    }
    void Flush() {
        stream_.Write(gathered_.Bytes());
        gathered_.Clear();
    }

    // Lets the interface work between rows; true when the user asked to stop.
    bool StoppedBetweenRows(int row) {
        if (row % kRowsPerTurn != 0) return false;
        return database_.Progress({.Cur = 0, .Max = database_.Count(), .Type = ptSaveDatabase}, false, false);
    }

    TMusicDatabase& database_;
    DeflateStream stream_;
    ByteWriter gathered_;
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
    WritePackedRecord(gathered_, song);
    for (const SongText& text : kSongTexts) {
        const QByteArray bytes = CodePage::CutSystem(CodePage::ToSystem(song.*text.Field), kLongestText);
        WriteNumber(static_cast<int>(bytes.size()));
        gathered_.Raw(std::string_view(bytes.constData(), static_cast<std::size_t>(bytes.size())));
    }
    FlushWhenFull();
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
