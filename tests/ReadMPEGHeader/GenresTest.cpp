#include "ReadMPEGHeader/Genres.h"

#include <gtest/gtest.h>

#include <set>

#include "ReadMPEGHeader/DerivedGenre.h"
#include "tests/ErrorOf.h"
#include "tests/PrintQt.h"

using namespace Qt::StringLiterals;

TEST(Genres, TableIsCompleteAndSortedByName) {
    std::set<int> numbers;
    QString previous;
    for (const GenreRow& row : GenreTable()) {
        const QString name = QString::fromUtf16(row.Name);
        EXPECT_LT(previous.compare(name, Qt::CaseInsensitive), 0) << name.toStdString();
        EXPECT_EQ(GenreByName(name), row.Number);
        numbers.insert(row.Number);
        previous = name;
    }
    EXPECT_EQ(numbers.size(), 148u);
    EXPECT_EQ(*numbers.rbegin(), 147);
}

TEST(Genres, NumbersWithoutARowHaveATextToo) {
    for (const int number : {-1, 148, 254})
        EXPECT_EQ(GenreName(number), u"Unbekannt"_s);
    EXPECT_EQ(GenreName(255), u"Undefiniert"_s);
}

TEST(Genres, MainGenreCountsModulo128) {
    EXPECT_EQ(MainGenreName(130), u"Comedy"_s);
    EXPECT_EQ(MainGenreLongName(4), u"Jazz/Blues/Latine/Reggae"_s);
    EXPECT_EQ(MainGenreGenre(12), 23);
    EXPECT_EQ(MainGenreGenre(128 + 19), 32);
    for (const int unknown : {0, 20, 25, 127, 128, -3}) {
        EXPECT_EQ(MainGenreName(unknown), u"?"_s);
        EXPECT_EQ(MainGenreGenre(unknown), kNoGenre);
    }
}

TEST(Genres, MainGenreIsFoundByEitherNameExactly) {
    for (int index = 0; index < kMainGenreCount; ++index) {
        EXPECT_EQ(MainGenreByName(MainGenreLongName(index)), index);
        EXPECT_EQ(MainGenreByName(MainGenreName(index)), index);
    }
    EXPECT_EQ(ErrorOf([] { MainGenreByName(u"comedy"_s); }),
              u"Genre nicht in der internen Tabelle gefunden"_s);
}

TEST(DerivedGenre, TextsAndNumbersBelongToAMainGenre) {
    // A genre that a main genre stands for belongs to it; rock in German is not told from other rock.
    for (int index = 1; index < kMainGenreCount; ++index)
        EXPECT_EQ(MainGenreOfGenre(MainGenreGenre(index)), index == 3 ? 8 : index);
    const std::pair<QString, int> cases[] = {{u"german rock"_s, 3},
                                             {u"Jzz/Bls/Lat/Reg"_s, 4},
                                             {u"Thrash Metal"_s, 14},
                                             {u"hip hop"_s, 18},
                                             {u"NEUE DEUTSCHE HARTE"_s, 3},
                                             {u"Unsinn; Indie Pop"_s, 1},
                                             {u"Pop / Rock"_s, 8},
                                             {u"?"_s, 0},
                                             {u"Unbekannt"_s, 0},
                                             {u";/,"_s, 0},
                                             {QString(), 0}};
    for (const auto& [text, mainGenre] : cases)
        EXPECT_EQ(MainGenreOfText(text), mainGenre) << text.toStdString();
    EXPECT_EQ(MainGenreOfGenre(148), 0);
    EXPECT_EQ(MainGenreOfGenre(-1), 0);
}
