#include "ReadMPEGHeader/DerivedGenre.h"

#include <QHash>
#include <QString>
#include <algorithm>
#include <array>

#include "CommonRUKTools/FoldedText.h"
#include "ReadMPEGHeader/Genres.h"

using namespace Qt::StringLiterals;

namespace {

// By genre number, ten a line. docs/formats.md has the same by name.
// clang-format off
constexpr std::array<quint8, 148> kByNumber = {{
    4, 8, 8, 17, 17, 1, 1, 18, 4, 14,  // 0
    5, 6, 0, 8, 9, 7, 4, 8, 15, 10,  // 10
    1, 4, 14, 12, 11, 15, 5, 9, 9, 4,  // 20
    4, 16, 19, 0, 15, 17, 11, 11, 9, 1,  // 30
    1, 15, 9, 1, 5, 5, 8, 8, 5, 10,  // 40
    10, 15, 15, 8, 17, 5, 8, 2, 0, 7,  // 50
    8, 7, 1, 15, 5, 2, 10, 1, 10, 11,  // 60
    11, 1, 15, 1, 4, 12, 6, 11, 6, 13,  // 70
    8, 8, 8, 4, 4, 4, 4, 6, 5, 8,  // 80
    1, 10, 8, 1, 8, 9, 4, 19, 9, 9,  // 90
    2, 0, 9, 19, 19, 19, 19, 18, 1, 1,  // 100
    2, 9, 17, 4, 4, 8, 9, 9, 9, 17,  // 110
    0, 1, 0, 9, 17, 4, 16, 15, 17, 15,  // 120
    15, 1, 8, 1, 1, 6, 7, 14, 14, 1,  // 130
    8, 8, 4, 4, 14, 11, 8, 10,  // 140
}};
// clang-format on

struct TextRow {
    const char16_t* Text;
    quint8 MainGenre;
};

// Beside the names of the genres and main genres.
constexpr std::array kTexts = std::to_array<TextRow>({
    {u"Alternative Rock", 1},
    {u"Indie Rock", 1},
    {u"Indie Pop", 1},
    {u"Post-Rock", 1},
    {u"Funk Rock", 1},
    {u"Kabarett", 2},
    {u"Parodie", 2},
    {u"Stand-Up", 2},
    {u"Deutschrock", 3},
    {u"Deutschpop", 3},
    {u"Deutsch Rock", 3},
    {u"German Pop", 3},
    {u"NDW", 3},
    {u"Neue Deutsche Welle", 3},
    {u"Neue Deutsche Härte", 3},
    {u"Bebop", 4},
    {u"Bossa Nova", 4},
    {u"Dancehall", 4},
    {u"Dub", 4},
    {u"Latin Pop", 4},
    {u"Smooth Jazz", 4},
    {u"Swing Jazz", 4},
    {u"Mittelalter", 5},
    {u"Medieval", 5},
    {u"Weltmusik", 5},
    {u"World", 5},
    {u"World Music", 5},
    {u"50s", 6},
    {u"60s", 6},
    {u"Evergreen", 6},
    {u"Evergreens", 6},
    {u"Rock 'n' Roll", 6},
    {u"Rock and Roll", 6},
    {u"Rockabilly", 6},
    {u"Deutschrap", 7},
    {u"German Rap", 7},
    {u"Trap", 7},
    {u"Americana", 8},
    {u"Blues Rock", 8},
    {u"Country Rock", 8},
    {u"Folk Rock", 8},
    {u"J-Pop", 8},
    {u"K-Pop", 8},
    {u"Pop Rock", 8},
    {u"Pop/Rock", 8},
    {u"Prog Rock", 8},
    {u"Chillout", 9},
    {u"Contemporary R&B", 9},
    {u"Downtempo", 9},
    {u"Liedermacher", 9},
    {u"Lounge", 9},
    {u"R'n'B", 9},
    {u"Rhythm and Blues", 9},
    {u"RnB", 9},
    {u"Singer-Songwriter", 9},
    {u"Singer/Songwriter", 9},
    {u"Soft Rock", 9},
    {u"Trip Hop", 9},
    {u"Dark Wave", 10},
    {u"EBM", 10},
    {u"Gothic Metal", 10},
    {u"Post-Punk", 10},
    {u"Synth Pop", 10},
    {u"Synth-Pop", 10},
    {u"Synthwave", 10},
    {u"Film Score", 11},
    {u"Filmmusik", 11},
    {u"Game Music", 11},
    {u"OST", 11},
    {u"Score", 11},
    {u"Video Game", 11},
    {u"Ballermann", 12},
    {u"Karneval", 12},
    {u"Party", 12},
    {u"Schlager", 12},
    {u"Volksmusik", 12},
    {u"Alternative Metal", 14},
    {u"Doom Metal", 14},
    {u"Folk Metal", 14},
    {u"Metalcore", 14},
    {u"Nu Metal", 14},
    {u"Power Metal", 14},
    {u"Progressive Metal", 14},
    {u"Speed Metal", 14},
    {u"Symphonic Metal", 14},
    {u"Breakbeat", 15},
    {u"Drum and Bass", 15},
    {u"Drum 'n' Bass", 15},
    {u"Dubstep", 15},
    {u"Electro", 15},
    {u"Electronica", 15},
    {u"IDM", 15},
    {u"Minimal", 15},
    {u"Hard Trance", 16},
    {u"Psychedelic Trance", 16},
    {u"Psytrance", 16},
    {u"Deep House", 17},
    {u"EDM", 17},
    {u"Progressive House", 17},
    {u"Tech House", 17},
    {u"Hip Hop", 18},
    {u"HipHop", 18},
    {u"Hip-Hop/Rap", 18},
    {u"Barock", 19},
    {u"Baroque", 19},
    {u"Classical Music", 19},
    {u"Klassik", 19},
    {u"Oper", 19},
    {u"Orchestral", 19},
});

using TextTable = QHash<QString, quint8>;

const TextTable& MainGenreNames() {
    static const TextTable table = [] {
        TextTable names;
        for (int index = 1; index < kMainGenreCount; ++index)
            for (const QString& name : {MainGenreLongName(index), MainGenreName(index)})
                names.insert(FoldText(name), static_cast<quint8>(index));
        return names;
    }();
    return table;
}

// Where lists have the same text, the names of the main genres stand before those of the genres.
const TextTable& AllTexts() {
    static const TextTable table = [] {
        TextTable texts;
        for (const TextRow& row : kTexts)
            texts.insert(FoldText(row.Text), row.MainGenre);
        for (const GenreRow& row : GenreTable())
            texts.insert(FoldText(row.Name), MainGenreOfGenre(row.Number));
        texts.insert(MainGenreNames());
        return texts;
    }();
    return table;
}

quint8 MainGenreOfWhole(QStringView text) {
    return AllTexts().value(FoldText(text.trimmed()));
}

bool SeparatesGenres(QChar c) {
    return c == u';' || c == u',' || c == u'/' || c == u'|' || c == u'\\';
}

}  // namespace

quint8 MainGenreOfGenre(int number) {
    const auto index = static_cast<std::size_t>(number);
    return number >= 0 && index < kByNumber.size() ? kByNumber[index] : quint8{0};
}

quint8 MainGenreNamed(QStringView text) {
    return MainGenreNames().value(FoldText(text.trimmed()));
}

quint8 MainGenreOfText(QStringView text) {
    if (const quint8 whole = MainGenreOfWhole(text)) return whole;
    while (!text.isEmpty()) {
        const auto end = std::ranges::find_if(text, SeparatesGenres);
        if (const quint8 part = MainGenreOfWhole(QStringView(text.begin(), end))) return part;
        text = end == text.end() ? QStringView() : QStringView(end + 1, text.end());
    }
    return 0;
}
