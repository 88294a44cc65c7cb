#include "ReadMPEGHeader/Genres.h"

#include <algorithm>
#include <array>

#include "CommonRUKTools/Errors.h"

using namespace Qt::StringLiterals;

namespace {

// Numbers 0 to 79 are the standard's, 80 to 147 the usual extension. Some spellings differ from other
// programs' ("Alt. Rock", "Folk/Rock", "Rock & Roll", "Drum & Bass", "Humour"): they stand in users'
// collections.
// clang-format off
constexpr std::array<GenreRow, 148> kGenres = {{
    {u"A Cappella", 123},
    {u"Acid", 34},
    {u"Acid Jazz", 74},
    {u"Acid Punk", 73},
    {u"Acoustic", 99},
    {u"Alt. Rock", 40},
    {u"Alternative", 20},
    {u"Ambient", 26},
    {u"Anime", 145},
    {u"Avantgarde", 90},
    {u"Ballad", 116},
    {u"Bass", 41},
    {u"Beat", 135},
    {u"Bebob", 85},
    {u"Big Band", 96},
    {u"Black Metal", 138},
    {u"Bluegrass", 89},
    {u"Blues", 0},
    {u"Booty Bass", 107},
    {u"BritPop", 132},
    {u"Cabaret", 65},
    {u"Celtic", 88},
    {u"Chamber Music", 104},
    {u"Chanson", 102},
    {u"Chorus", 97},
    {u"Christian Gangsta Rap", 136},
    {u"Christian Rap", 61},
    {u"Christian Rock", 141},
    {u"Classic Rock", 1},
    {u"Classical", 32},
    {u"Club", 112},
    {u"Club-House", 128},
    {u"Comedy", 57},
    {u"Contemporary Christian", 140},
    {u"Country", 2},
    {u"Crossover", 139},
    {u"Cult", 58},
    {u"Dance", 3},
    {u"Dance Hall", 125},
    {u"Darkwave", 50},
    {u"Death Metal", 22},
    {u"Disco", 4},
    {u"Dream", 55},
    {u"Drum & Bass", 127},
    {u"Drum Solo", 122},
    {u"Duet", 120},
    {u"Easy Listening", 98},
    {u"Electronic", 52},
    {u"Ethnic", 48},
    {u"Euro-House", 124},
    {u"Euro-Techno", 25},
    {u"Eurodance", 54},
    {u"Fast-Fusion", 84},
    {u"Folk", 80},
    {u"Folk/Rock", 81},
    {u"Folklore", 115},
    {u"Freestyle", 119},
    {u"Funk", 5},
    {u"Fusion", 30},
    {u"Game", 36},
    {u"Gangsta Rap", 59},
    {u"Goa", 126},
    {u"Gospel", 38},
    {u"Gothic", 49},
    {u"Gothic Rock", 91},
    {u"Grunge", 6},
    {u"Hard Rock", 79},
    {u"Hardcore", 129},
    {u"Heavy Metal", 137},
    {u"Hip-Hop", 7},
    {u"House", 35},
    {u"Humour", 100},
    {u"Indie", 131},
    {u"Industrial", 19},
    {u"Instrumental", 33},
    {u"Instrumental Pop", 46},
    {u"Instrumental Rock", 47},
    {u"Jazz", 8},
    {u"Jazz+Funk", 29},
    {u"JPop", 146},
    {u"Jungle", 63},
    {u"Latin", 86},
    {u"Lo-Fi", 71},
    {u"Meditative", 45},
    {u"Merengue", 142},
    {u"Metal", 9},
    {u"Musical", 77},
    {u"National Folk", 82},
    {u"Native American", 64},
    {u"Negerpunk", 133},
    {u"New Age", 10},
    {u"New Wave", 66},
    {u"Noise", 39},
    {u"Oldies", 11},
    {u"Opera", 103},
    {u"Other", 12},
    {u"Polka", 75},
    {u"Polsk Punk", 134},
    {u"Pop", 13},
    {u"Pop-Folk", 53},
    {u"Pop/Funk", 62},
    {u"Porn Groove", 109},
    {u"Power Ballad", 117},
    {u"Pranks", 23},
    {u"Primus", 108},
    {u"Progressive Rock", 92},
    {u"Psychedelic", 67},
    {u"Psychedelic Rock", 93},
    {u"Punk", 43},
    {u"Punk Rock", 121},
    {u"R&B", 14},
    {u"Rap", 15},
    {u"Rave", 68},
    {u"Reggae", 16},
    {u"Retro", 76},
    {u"Revival", 87},
    {u"Rhythmic Soul", 118},
    {u"Rock", 17},
    {u"Rock & Roll", 78},
    {u"Salsa", 143},
    {u"Samba", 114},
    {u"Satire", 110},
    {u"Showtunes", 69},
    {u"Ska", 21},
    {u"Slow Jam", 111},
    {u"Slow Rock", 95},
    {u"Sonata", 105},
    {u"Soul", 42},
    {u"Sound Clip", 37},
    {u"Soundtrack", 24},
    {u"Southern Rock", 56},
    {u"Space", 44},
    {u"Speech", 101},
    {u"Swing", 83},
    {u"Symphonic Rock", 94},
    {u"Symphony", 106},
    {u"Synthpop", 147},
    {u"Tango", 113},
    {u"Techno", 18},
    {u"Techno-Industrial", 51},
    {u"Terror", 130},
    {u"Thrash Metal", 144},
    {u"Top 40", 60},
    {u"Trailer", 70},
    {u"Trance", 31},
    {u"Tribal", 72},
    {u"Trip-Hop", 27},
    {u"Vocal", 28},
}};
// clang-format on

struct MainGenreRow {
    const char16_t* LongName;
    const char16_t* Name;
    quint8 Genre;
};

constexpr std::array<MainGenreRow, kMainGenreCount> kMainGenres = {{
    {u"Unbekannt", u"?", kNoGenre},
    {u"Alternative/Psychedelic/Punk/Funk", u"Alt/Psy/Pnk/Fnk", 62},
    {u"Comedy", u"Comedy", 57},
    {u"German Rock", u"German Rock", 17},
    {u"Jazz/Blues/Latine/Reggae", u"Jzz/Bls/Lat/Reg", 86},
    {u"Mystic", u"Mystic", 55},
    {u"Oldies", u"Oldies", 11},
    {u"Rap", u"Rap", 15},
    {u"Rock/Pop", u"Rock/Pop", 13},
    {u"Soul/Soft", u"Soul/Soft", 42},
    {u"Wave/Rave", u"Wave/Rave", 68},
    {u"Trailers/Game-Sounds", u"Trail./Game", 70},
    {u"Partyhits", u"Partyhits", 23},
    {u"Hard Rock", u"Hard Rock", 79},
    {u"Metal", u"Metal", 9},
    {u"Techno", u"Techno", 18},
    {u"Trance", u"Trance", 31},
    {u"Dance", u"Dance", 3},
    {u"Hip-Hop", u"Hip-Hop", 7},
    {u"Classic", u"Classic", 32},
}};

// The upper bit of a stored main genre is not part of the index.
const MainGenreRow& MainGenreAt(int index) {
    const int row = index % 128;
    return kMainGenres[row < 0 || row >= kMainGenreCount ? 0u : static_cast<std::size_t>(row)];
}

int MainGenreRowWith(const char16_t* MainGenreRow::*field, const QString& name) {
    const auto found = std::ranges::find_if(
        kMainGenres, [&](const MainGenreRow& row) { return name == QStringView(row.*field); });
    return found == kMainGenres.end() ? -1 : static_cast<int>(found - kMainGenres.begin());
}

}  // namespace

std::span<const GenreRow> GenreTable() {
    return kGenres;
}

QString GenreName(int number) {
    if (number == kNoGenre) return u"Undefiniert"_s;
    const auto found = std::ranges::find(kGenres, number, &GenreRow::Number);
    return found == kGenres.end() ? u"Unbekannt"_s : QString::fromUtf16(found->Name);
}

std::optional<quint8> GenreByName(QStringView name) {
    const auto found = std::ranges::find_if(kGenres, [name](const GenreRow& row) {
        return name.compare(QStringView(row.Name), Qt::CaseInsensitive) == 0;
    });
    if (found == kGenres.end()) return std::nullopt;
    return found->Number;
}

QString MainGenreName(int index) {
    return QString::fromUtf16(MainGenreAt(index).Name);
}

QString MainGenreLongName(int index) {
    return QString::fromUtf16(MainGenreAt(index).LongName);
}

quint8 MainGenreGenre(int index) {
    return MainGenreAt(index).Genre;
}

int MainGenreByName(const QString& name) {
    int index = MainGenreRowWith(&MainGenreRow::LongName, name);
    if (index < 0) index = MainGenreRowWith(&MainGenreRow::Name, name);
    if (index < 0) throw ERukException(u"Genre nicht in der internen Tabelle gefunden"_s);
    return index;
}
