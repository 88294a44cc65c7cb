#include "MusicManagment/database/tsdb/DatabaseFile.h"

#include <gtest/gtest.h>

#include <random>

#include "MusicManagment/database/MusicManagment.h"
#include "tests/ErrorOf.h"
#include "tests/PrintQt.h"
#include "tests/database/DatabaseBuilder.h"
#include "tests/database/SongFolder.h"

using namespace Qt::StringLiterals;

namespace {

void Load(TMusicDatabase& database, ByteSpan file) {
    MemorySource source(file);
    ASSERT_TRUE(ReadDatabase(database, source));
}

// The message that loading ends with; empty when it succeeds.
QString LoadError(TMusicDatabase& database, ByteSpan file) {
    MemorySource source(file);
    return ErrorOf([&] { ReadDatabase(database, source); });
}

QStringList Rows(const SortedTextList& list) {
    QStringList rows;
    for (const auto& row : list)
        rows << row.Text + u'=' + QString::number(row.Number);
    return rows;
}

TID3Tag FullSong() {
    TID3Tag song;
    song.FileName = u"/Müsik/a.mp3"_s;
    song.Title = u"Ein Titel 🎵"_s;
    song.Artist = u"Die Ärzte"_s;
    song.Album = u"Geräusch"_s;
    song.Year = u"2003"_s;
    song.Comment = u"Zeile 1\r\nZeile 2"_s;
    song.MPEGLayer = u"MPEG 1.0 Layer III"_s;
    song.Length = 65535;
    song.Genre = 17;
    song.BitRate = 320;
    song.SampleRate = 48000;
    song.ChannelMode = 3;
    song.Emphasis = 2;
    song.Private = true;
    song.Copyrighted = true;
    song.Padding = true;
    song.FrameSize = 1044;
    song.Track = 12;
    song.PlayCount = 4'000'000'000u;
    song.Reserved = 65535;
    song.Flags = 0xF000000Fu;
    song.MainGenre = 19;
    song.Remix = true;
    song.AddTime = 38'000.25;
    return song;
}

class DatabaseFileTest : public testing::Test {
 protected:
    QString Path() const { return folder_.Path(u"songs.tsdb"_s); }
    Bytes SavedFile(TMusicDatabase& database) const {
        EXPECT_TRUE(database.SaveDatabase(Path(), true));
        FileSource file(Path());
        return file.ReadExactly(0, static_cast<std::size_t>(file.Size()));
    }
    static void Add(TMusicDatabase& database, const TID3Tag& song) {
        database.AddEntry(QString(), song, AddAs::Loaded);
        database.RecountGroups();
    }
    SongFolder folder_;
};

}  // namespace

TEST_F(DatabaseFileTest, EverythingComesBackAsItWasSaved) {
    TMusicDatabase saved;
    Add(saved, FullSong());
    TID3Tag opposite;
    opposite.FileName = u":0123ABCD:\\Musik\\b.mp3"_s;
    opposite.Year = u"0"_s;
    opposite.Protected = true;
    opposite.Original = true;
    opposite.AddTime = 1;
    Add(saved, opposite);
    saved.SetUpdateFolders({u"/Müsik"_s, u"/mnt/b"_s});
    ASSERT_TRUE(saved.SaveDatabase(Path()));
    EXPECT_FALSE(saved.Modified());
    EXPECT_EQ(saved.FileName(), Path());

    TMusicDatabase loaded;
    ASSERT_TRUE(loaded.OpenDatabase(Path()));
    ASSERT_EQ(loaded.Count(), 2);
    EXPECT_EQ(loaded.Song(0), saved.Song(0));
    EXPECT_EQ(loaded.Song(1), saved.Song(1));
    EXPECT_EQ(loaded.UpdateFolders(), saved.UpdateFolders());
    EXPECT_EQ(Rows(loaded.Artists()), Rows(saved.Artists()));
    EXPECT_EQ(Rows(loaded.Albums()), Rows(saved.Albums()));
    EXPECT_EQ(Rows(loaded.Years()), Rows(saved.Years()));
    EXPECT_EQ(Rows(loaded.Lengths()), Rows(saved.Lengths()));
    EXPECT_EQ(loaded.Genres(), saved.Genres());
    EXPECT_FALSE(loaded.Modified());
    EXPECT_EQ(loaded.FileName(), Path());
}

TEST_F(DatabaseFileTest, TheCompressionLevelStandsInTheStreamAndAllAreRead) {
    TMusicDatabase database;
    for (int i = 0; i < 300; ++i)
        database.AddEntry(QStringLiteral("/m/%1.mp3").arg(i, 5), FullSong(), AddAs::Loaded);
    // The two highest bits of the second byte of a zlib stream: 0 fastest, 2 default, 3 best.
    for (const auto& [level, mark] : {std::pair{clNone, 0}, {clFastest, 0}, {clDefault, 2}, {clMax, 3}}) {
        database.SetCompression(level);
        const Bytes file = SavedFile(database);
        EXPECT_EQ(file[18] >> 6, mark);
        TMusicDatabase loaded;
        Load(loaded, file);
        EXPECT_EQ(loaded.Count(), 300);
    }
}

TEST_F(DatabaseFileTest, EachFieldOfARecordHasItsPlace) {
    TMusicDatabase database;
    Add(database, FullSong());
    const Bytes body = Inflated(ByteSpan(SavedFile(database)).subspan(17));
    ByteWriter record;
    record.Raw(std::string_view("\xD3\x07\xFF\xFF\x11\x40\x01\x80\xBB\x03\x02\x01\x00\x01\x00\x01", 16));
    record.Raw(std::string_view("\x14\x04\x0C\x00\x28\x6B\xEE\xFF\xFF\x0F\x00\x00\xF0\x13\x01", 15));
    record.F64Le(38'000.25);
    record.U32Le(13);
    record.Raw("/M\xC3\xBCsik/a.mp3");
    record.U32Le(14);
    record.Raw("Ein Titel \xF0\x9F\x8E\xB5");
    ASSERT_GE(body.size(), record.Size());
    const auto start = AsText(body).find(AsText(ByteSpan(record.Bytes()).first(39)));
    ASSERT_NE(start, std::string_view::npos);
    EXPECT_EQ(AsText(body).substr(start, record.Size()), AsText(record.Bytes()));
    EXPECT_EQ(start, 4 + 2 * (4 + 516) + 2 * (4 + 132) + 4 + 80u);
}

TEST_F(DatabaseFileTest, AYearIsStoredAsANumberOf16Bits) {
    const std::pair<QString, QString> cases[] = {{u"1984"_s, u"1984"_s}, {u""_s, u"0"_s},
                                                 {u"0000"_s, u"0"_s},    {u"um 1970"_s, u"0"_s},
                                                 {u"-5"_s, u"0"_s},      {u"99999"_s, u"65535"_s}};
    for (const auto& [stored, loaded] : cases) {
        TMusicDatabase database;
        TID3Tag song = FullSong();
        song.Year = stored;
        Add(database, song);
        TMusicDatabase copy;
        Load(copy, SavedFile(database));
        EXPECT_EQ(copy.Song(0).Year, loaded) << stored.toStdString();
    }
}

TEST_F(DatabaseFileTest, TextsAreCutToTheirFieldsWithoutSplittingACharacter) {
    TMusicDatabase database;
    TID3Tag song = FullSong();
    song.Artist = QString(511, u'a') + u"ö"_s;  // 513 bytes
    song.Album = QString(512, u'b');
    song.Title = QString(70'000, u't');
    song.Comment = QString(65'534, u'c') + u"ö"_s;
    Add(database, song);
    const QString full = u'/' + QString(259, u'f');
    database.SetUpdateFolders({full, u'/' + QString(258, u'g') + u"ö"_s, full + u"long"_s});

    TMusicDatabase loaded;
    Load(loaded, SavedFile(database));
    // The caption is cut in the file, but a group of that name would be nobody's.
    EXPECT_EQ(Rows(loaded.Artists()), QStringList{song.Artist + u"=1"_s});
    EXPECT_TRUE(loaded.RemoveEntry(0));
    EXPECT_EQ(loaded.Artists().Count(), 0);
    Load(loaded, SavedFile(database));
    EXPECT_EQ(Rows(loaded.Albums()), QStringList{QString(512, u'b') + u"=1"_s});
    EXPECT_EQ(loaded.Song(0).Artist, song.Artist);
    EXPECT_EQ(loaded.Song(0).Title, QString(65'535, u't'));
    EXPECT_EQ(loaded.Song(0).Comment, QString(65'534, u'c'));
    EXPECT_EQ(loaded.UpdateFolders(), (QStringList{full, u'/' + QString(258, u'g'), full}));
}

TEST_F(DatabaseFileTest, SongsKeepTheOrderOfTheFileUntilOneIsPlaced) {
    DatabaseBuilder builder;
    builder.EmptyLists();
    for (int i = 0; i < 51; ++i)
        builder.Song({std::to_string(i), "", i == 50 ? "A" : "C"});
    TMusicDatabase database;
    // Whatever happens while loading, the order is looked at again.
    database.OnProgress = [](TMusicDatabase& sender, const ProgressPoint&) { sender.EnsureSorted(); };
    Load(database, builder.SongCount(51).File());
    database.OnProgress = nullptr;
    EXPECT_EQ(database.Song(50).Artist, u"A"_s);
    TID3Tag song;
    song.Artist = u"B"_s;
    EXPECT_EQ(database.AddEntry(u"b"_s, song, AddAs::Loaded), 1);
    EXPECT_EQ(database.Song(0).Artist, u"A"_s);
}

// Only as many numbers as there are genres are in the list, whatever its count says.
TEST_F(DatabaseFileTest, AGenreListMayClaimMoreOrFewerRows) {
    TMusicDatabase database;
    DatabaseBuilder more;
    more.SongCount(1).Zeros(5 * 4).Number(25);
    for (int genre = 0; genre < 20; ++genre)
        more.Number(100 + genre);
    Load(database, more.Song({"a"}).File());
    EXPECT_EQ(database.Genres()[19], 119);
    EXPECT_EQ(database.Count(), 1);

    Load(database, DatabaseBuilder().Zeros(5 * 4).Number(1).Number(7).File());
    EXPECT_EQ(database.Genres()[0], 7);
    EXPECT_EQ(database.Genres()[19], 0);
}

// --- Damage ---

namespace {

struct Damage {
    const char* Name;
    Bytes File;
    QString Message;
    int Songs;  // that are kept
};

Bytes CutBy(Bytes file, std::size_t count) {
    file.resize(file.size() - count);
    return file;
}

Bytes Changed(Bytes file, std::size_t position, std::uint8_t value) {
    file[position] = value;
    return file;
}

Bytes With(Bytes file, std::string_view tail) {
    file.insert(file.end(), tail.begin(), tail.end());
    return file;
}

DatabaseBuilder OneSong() {
    return DatabaseBuilder().SongCount(1).EmptyLists().Song({"a", "b"});
}

// Bytes that deflate cannot make smaller, so that a damaged one is met only when it is needed.
std::string Noise(std::size_t size) {
    std::mt19937 random(1);
    std::string noise(size, 'x');
    for (char& c : noise)
        c = static_cast<char>(1 + random() % 255);
    return noise;
}

std::vector<Damage> Damages() {
    const QString end = u"Fehler in der Datenbank: Unerwartetes Ende"_s;
    const QString damaged = u"Fehler in der Datenbank: Die komprimierten Daten sind beschädigt"_s;
    const QString version = u"Diese Datenbank liegt in einer ungültigen Version vor: "_s;
    const Bytes good = OneSong().File();
    const std::string noise = Noise(60'000);
    DatabaseBuilder nineSongs;
    nineSongs.SongCount(9).EmptyLists();
    for (int i = 0; i < 9; ++i)
        nineSongs.Song({noise});
    const Bytes large = nineSongs.File();
    return {
        {"another magic", Changed(good, 10, 'k'), u"Dies ist keine gültige Datenbank."_s, 0},
        {"version 2.1", DatabaseBuilder(2, 1).File(), version + u"2.1"_s, 0},
        {"a negative song count", DatabaseBuilder().SongCount(-1).EmptyLists().File(),
         u"Fehler in der Datenbank: Ungültige Anzahl (-1)"_s, 0},
        {"a negative list count", DatabaseBuilder().NoFolders().Number(-2).File(),
         u"Fehler in der Datenbank: Ungültige Anzahl (-2)"_s, 0},
        {"no zlib stream", With(Bytes(good.begin(), good.begin() + 17), "plain text"), damaged, 0},
        {"more songs than there are", OneSong().SongCount(0x7FFFFFFF).File(), end, 1},
        {"a cut text", OneSong().SongCount(2).Zeros(39).Number(5).Raw(AsBytes("abcd")).File(), end, 1},
        {"a text of 4 GB", OneSong().SongCount(2).Zeros(39).Number(0xFFFFFFFF).File(),
         u"Fehler in der Datenbank: Zu langer FileName-String (4294967295 Zeichen)"_s, 1},
        {"a comment of 64 KB",
         DatabaseBuilder().SongCount(1).EmptyLists().Song({"", "", "", "", std::string(65'536, 'x')}).File(),
         u"Fehler in der Datenbank: Zu langer Kommentar-String (65536 Zeichen)"_s, 0},
        {"a cut stream", CutBy(large, 70'000), end, 7},
        {"no checksum", CutBy(good, 4), end, 1},
        {"another checksum", Changed(good, good.size() - 1, static_cast<std::uint8_t>(good.back() ^ 1)),
         u"Fehler in der Datenbank: Die Prüfsumme stimmt nicht"_s, 1},
        {"bytes behind the stream", With(good, "x"),
         u"Fehler in der Datenbank: Unbekannte Daten hinter dem Ende der Datenbank"_s, 1},
        {"bytes behind the last song", OneSong().Zeros(1).File(),
         u"Fehler in der Datenbank: Unbekannte Daten hinter dem letzten Song"_s, 1},
        {"a cut record of version 1.2", DatabaseBuilder(1, 2).SongCount(1).EmptyLists().Zeros(1336).File(),
         u"Fehler in der Datenbank"_s, 0},
    };
}

}  // namespace

TEST_F(DatabaseFileTest, DamageEndsInItsMessageAndKeepsTheSongsBeforeIt) {
    for (const Damage& damage : Damages()) {
        SCOPED_TRACE(damage.Name);
        TMusicDatabase database;
        Add(database, FullSong());
        bool sawEnd = false;
        database.OnChange = [&](TMusicDatabase& sender, SongIndex, TChangeType change) {
            sawEnd = change == ctChanged && !sender.Loading();
        };
        EXPECT_EQ(LoadError(database, damage.File), damage.Message);
        EXPECT_EQ(database.Count(), damage.Songs);
        EXPECT_FALSE(database.Loading());
        EXPECT_FALSE(database.ProgressRunning());
        EXPECT_FALSE(database.Modified());
        EXPECT_EQ(Rows(database.Artists()),
                  damage.Songs == 0 ? QStringList() : QStringList{u"=%1"_s.arg(damage.Songs)});
        EXPECT_TRUE(sawEnd || damage.Songs == 0);
    }
}

TEST_F(DatabaseFileTest, ViewsReserveNoMoreThanTheFileCanHold) {
    TMusicDatabase database;
    int reserved = -1;
    database.OnPrepareMultiAdd = [&](TMusicDatabase&, int count) { reserved = count; };
    const Bytes hostile = OneSong().SongCount(0x7FFFFFFF).File();
    LoadError(database, hostile);
    EXPECT_GE(reserved, 1);
    EXPECT_LE(reserved, static_cast<int>(hostile.size()) * 17);
    Load(database, OneSong().File());
    EXPECT_EQ(reserved, 1);
}
