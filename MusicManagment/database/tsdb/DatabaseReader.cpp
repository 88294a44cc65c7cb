#include <algorithm>
#include <array>
#include <cstring>
#include <memory>
#include <string>
#include <vector>

#include "CommonRUKTools/CodePage.h"
#include "CommonRUKTools/Dialogs.h"
#include "CommonRUKTools/TextPool.h"
#include "MusicManagment/database/ListGuards.h"
#include "MusicManagment/database/MusicManagment.h"
#include "MusicManagment/database/tsdb/DatabaseFile.h"
#include "MusicManagment/database/tsdb/DatabaseFormat.h"
#include "MusicManagment/database/tsdb/InflateStream.h"
#include "MusicManagment/database/tsdb/OldRecords.h"
#include "MusicManagment/database/tsdb/PackedRecord.h"

using namespace Qt::StringLiterals;
using namespace DatabaseFormat;

namespace {

[[noreturn]] void ThrowCutOff() {
    throw EMusicDatabaseException(u"Fehler in der Datenbank: Unerwartetes Ende"_s);
}

[[noreturn]] void ThrowTooLong(const SongText& text, std::uint32_t length) {
    throw EMusicDatabaseException(u"Fehler in der Datenbank: Zu langer "_s + text.Word.toString() +
                                  u"-String ("_s + QString::number(length) + u" Zeichen)"_s);
}

int ValidCount(std::uint32_t stored) {
    const auto count = static_cast<int>(stored);
    if (count < 0)
        throw EMusicDatabaseException(u"Fehler in der Datenbank: Ungültige Anzahl ("_s +
                                      QString::number(count) + u')');
    return count;
}

// --- Header ---

struct Header {
    int Version = 0;
    int SongCount = 0;

    bool HasLists() const { return Version >= kVersion12; }
};

Header ReadHeader(ByteSource& source) {
    std::array<std::uint8_t, kHeaderSize> bytes{};
    const std::size_t size = source.ReadAt(0, bytes);
    if (!StartsWith(ByteSpan(bytes).first(size), kMagic))
        throw EMusicDatabaseException(u"Dies ist keine gültige Datenbank."_s);
    if (size < kCountOffset) ThrowCutOff();
    ByteReader reader(bytes);
    reader.Skip(kMagic.size());
    const int major = reader.U8();
    const int minor = reader.U8();
    Header header;
    header.Version = major * 256 + minor;
    constexpr std::array kKnown = {kVersion10, kVersion11, kVersion12, kVersion20};
    if (std::find(kKnown.begin(), kKnown.end(), header.Version) == kKnown.end())
        throw EMusicDatabaseException(u"Diese Datenbank liegt in einer ungültigen Version vor: "_s +
                                      QString::number(major) + u'.' + QString::number(minor));
    if (size < kHeaderSize) ThrowCutOff();
    header.SongCount = ValidCount(reader.U32Le());
    return header;
}

// --- Texts and years that many songs share ---

// Keeps the texts seen last, which most often are those of the next song too: an artist's songs come from a
// few albums.
class RecentTexts {
 public:
    QString Get(ByteSpan bytes, TextPool& pool) {
        if (bytes.empty()) return {};
        Entry& entry = entries_[Place(bytes)];
        if (bytes.size() != entry.Bytes.size() || !StartsWith(bytes, entry.Bytes)) {
            entry.Text = pool.Get(bytes);
            entry.Bytes.assign(AsText(bytes));
        }
        return entry.Text;
    }

 private:
    struct Entry {
        std::string Bytes;
        QString Text;
    };
    static constexpr std::size_t kEntries = 64;

    static std::size_t Place(ByteSpan bytes) {
        return (bytes.size() + bytes.back() + 3u * bytes[bytes.size() / 2]) % kEntries;
    }

    std::array<Entry, kEntries> entries_;
};

class YearTexts {
 public:
    const QString& Get(quint16 year) {
        QString& text = texts_[year];
        if (text.isNull()) text = QString::number(year);
        return text;
    }

 private:
    std::vector<QString> texts_ = std::vector<QString>(65536);
};

// --- Body ---

class BodyReader {
 public:
    BodyReader(TMusicDatabase& database, ByteSource& source, const Header& header)
        : database_(database), header_(header), source_(source), stream_(source, kHeaderSize) {}

    // False when the user stopped the run.
    bool Read() {
        if (!ReadUpdateFolders()) return false;
        if (header_.HasLists() && !ReadLists()) return false;
        database_.Events().Reserve.Tell(PossibleSongs());
        if (!ReadSongs()) return false;
        if (endIsKnown_) stream_.ExpectEnd();
        return true;
    }

    // Whether the group lists that were read count exactly the songs that were taken in, by their own names.
    bool ListsAreValid() const { return !header_.HasLists() || (lost_.Left == 0 && !captionWasCut_); }
    const LostSongs& Lost() const { return lost_; }

 private:
    ByteSpan Take(std::size_t size) {
        const ByteSpan bytes = stream_.Take(size);
        if (bytes.size() < size) ThrowCutOff();
        return bytes;
    }
    std::uint32_t TakeNumber() { return ByteReader(Take(4)).U32Le(); }
    ByteSpan TakeBlock(std::size_t size) {
        const ByteSpan block = Take(size);
        const void* end = std::memchr(block.data(), 0, size);
        return end == nullptr ? block
                              : block.first(static_cast<std::size_t>(static_cast<const std::uint8_t*>(end) -
                                                                     block.data()));
    }

    bool ReadUpdateFolders();
    bool ReadLists();
    bool ReadList(const GroupList& list);
    void ReadGenres();
    bool ReadSongs();
    void ReadSong();
    void ReadTexts(TID3Tag& song);
    void ReadOldSong();

    // Lets the interface work between rows; true when the user asked to stop.
    bool StoppedBetweenRows(int row) {
        if (row % kRowsPerTurn != 0) return false;
        return database_.Progress({.Cur = 0, .Max = header_.SongCount, .Type = ptLoadDatabase}, false, false);
    }

    // The song count of the header, but no more than the file can hold.
    int PossibleSongs() const {
        // Deflate makes at most 1032 bytes of one (https://zlib.net/zlib_tech.html).
        constexpr std::int64_t kBestRatio = 1032;
        const auto recordSize = static_cast<std::int64_t>(header_.Version == kVersion20
                                                              ? kPackedRecordSize + 4 * kSongTexts.size()
                                                              : OldRecordSize(header_.Version));
        const std::int64_t most = source_.Size() * kBestRatio / recordSize;
        return static_cast<int>(std::min<std::int64_t>(header_.SongCount, most));
    }

    TMusicDatabase& database_;
    Header header_;
    ByteSource& source_;
    InflateStream stream_;
    TextPool pool_;
    YearTexts years_;
    std::array<RecentTexts, kSongTexts.size()> recent_;
    bool endIsKnown_ = true;
    bool captionWasCut_ = false;
    LostSongs lost_;
};

bool BodyReader::ReadUpdateFolders() {
    const int count = ValidCount(TakeNumber());
    QStringList folders;
    for (int row = 0; row < count; ++row) {
        if (StoppedBetweenRows(row)) return false;
        folders << CodePage::FromSystem(TakeBlock(kFolderBlock));
    }
    database_.SetUpdateFolders(folders);
    return true;
}

bool BodyReader::ReadLists() {
    for (const GroupList& list : kGroupLists)
        if (!ReadList(list)) return false;
    ReadGenres();
    return true;
}

bool BodyReader::ReadList(const GroupList& list) {
    const int count = ValidCount(TakeNumber());
    for (int row = 0; row < count; ++row) {
        if (StoppedBetweenRows(row)) return false;
        const QString caption = pool_.Get(TakeBlock(list.Block));
        const auto songs = static_cast<int>(TakeNumber());
        database_.EditGroups().AddRow(list.Type, caption, songs);
    }
    return true;
}

void BodyReader::ReadGenres() {
    const int count = ValidCount(TakeNumber());
    for (int genre = 0; genre < std::min(count, kMainGenreCount); ++genre)
        database_.EditGroups().SetGenreCount(genre, static_cast<int>(TakeNumber()));
    // A file with more genres than we know may hold more than we know elsewhere too.
    endIsKnown_ = count <= kMainGenreCount;
}

bool BodyReader::ReadSongs() {
    for (int index = 0; index < header_.SongCount; ++index) {
        if (index % kSongsPerPoint == 0 &&
            database_.Progress({.Cur = index, .Max = header_.SongCount, .Type = ptLoadDatabase}))
            return false;
        if (header_.Version == kVersion20)
            ReadSong();
        else
            ReadOldSong();
    }
    return true;
}

void BodyReader::ReadSong() {
    TID3Tag song;
    ByteReader numbers(Take(kPackedRecordSize));
    song.Year = years_.Get(ReadPackedRecord(numbers, song));
    ReadTexts(song);
    database_.AddEntry(QString(), std::move(song), AddAs::Loaded);
}

void BodyReader::ReadTexts(TID3Tag& song) {
    for (std::size_t i = 0; i < kSongTexts.size(); ++i) {
        const SongText& text = kSongTexts[i];
        const std::uint32_t length = TakeNumber();
        if (length > kLongestText) ThrowTooLong(text, length);
        const ByteSpan bytes = Take(length);
        if (text.CaptionRoom > 0 && length > text.CaptionRoom) captionWasCut_ = true;
        song.*text.Field = text.Repeats ? recent_[i].Get(bytes, pool_) : CodePage::FromSystem(bytes);
    }
}

void BodyReader::ReadOldSong() {
    const std::size_t size = OldRecordSize(header_.Version);
    const ByteSpan bytes = stream_.Take(size);
    if (bytes.size() < size) throw EMusicDatabaseException(u"Fehler in der Datenbank"_s);
    AddOldSong(database_, bytes, header_.Version, header_.HasLists(), lost_);
}

void TellLostSongs(const LostSongs& lost) {
    QStringList lines;
    if (lost.Kept > 0)
        lines << u"Die Musikdateien von "_s + QString::number(lost.Kept) +
                     u" Song(s) dieser Datenbank sind nicht da oder nicht lesbar. Diese Songs bleiben ohne "
                     "ihre Tags in der Datenbank."_s;
    if (lost.Left > 0)
        lines << QString::number(lost.Left) +
                     u" Song(s) dieser Datenbank wurden nicht übernommen, weil ihre Musikdateien nicht da "
                     "sind oder weil sie in der Bann-Liste stehen."_s;
    if (!lines.isEmpty()) UserDialogs().ShowMessage(MessageKind::Warning, lines.join(u'\n'));
}

// False when the user stopped the run.
bool ReadBody(TMusicDatabase& database, ByteSource& source, const Header& header, LostSongs& lost) {
    const ProgressRun run(database, u"Entpacke und lese Datenbank"_s);
    const LoadingGuard loading(database);
    BodyReader reader(database, source, header);
    const bool finished = reader.Read();
    lost = reader.Lost();
    if (!finished) return false;
    if (!reader.ListsAreValid())
        database.RecountGroups();
    else if (header.HasLists())
        database.Groups().TellRebuilt();
    return true;
}

// The songs that were read before the end stay; the lists, which count all songs of the file, cannot.
void SettleForPart(TMusicDatabase& database) {
    database.RecountGroups();
    database.SetModified(false);
    database.Events().Replaced.Tell();
}

}  // namespace

bool ReadDatabase(TMusicDatabase& database, ByteSource& stream) {
    RefuseReadingNow(database);
    database.Clear(true, true);
    const Header header = ReadHeader(stream);
    bool finished = false;
    LostSongs lost;
    try {
        finished = ReadBody(database, stream, header, lost);
    } catch (...) {
        SettleForPart(database);
        throw;
    }
    if (!finished) {
        SettleForPart(database);
        return false;
    }
    database.Events().Replaced.Tell();
    database.SetModified(false);
    TellLostSongs(lost);
    return true;
}

void RefuseReadingNow(TMusicDatabase& database) {
    RefuseDuringRun(database);
    if (database.Busy()) throw EMusicDatabaseException(u"Lesen der Datenbank ist momentan nicht möglich."_s);
}
