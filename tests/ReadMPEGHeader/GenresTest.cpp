#include "ReadMPEGHeader/Genres.h"

#include <gtest/gtest.h>

#include <set>

#include "CommonRUKTools/Errors.h"
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

TEST(Genres, NumbersHaveNames) {
    const std::pair<int, QString> cases[] = {
        {0, u"Blues"_s},       {17, u"Rock"_s},      {40, u"Alt. Rock"_s},    {79, u"Hard Rock"_s},
        {100, u"Humour"_s},    {147, u"Synthpop"_s}, {148, u"Unbekannt"_s},   {200, u"Unbekannt"_s},
        {254, u"Unbekannt"_s}, {-1, u"Unbekannt"_s}, {255, u"Undefiniert"_s},
    };
    for (const auto& [number, name] : cases)
        EXPECT_EQ(GenreName(number), name);
}

TEST(Genres, NamesAreFoundInAnyCase) {
    EXPECT_EQ(GenreByName(u"hip-HOP"), 7);
    EXPECT_EQ(GenreByName(u"Hip Hop"), std::nullopt);
    EXPECT_EQ(GenreByName(u""), std::nullopt);
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
    for (const QString& name : {u"comedy"_s, u"Pop"_s, QString()}) {
        try {
            MainGenreByName(name);
            ADD_FAILURE() << name.toStdString();
        } catch (const ERukException& error) {
            EXPECT_EQ(error.Message(), u"Genre nicht in der internen Tabelle gefunden"_s);
        }
    }
}
