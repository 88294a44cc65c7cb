#include "MusicManagment/database/duplicates/PairSearch.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <numeric>
#include <random>

#include "CommonRUKTools/ColognePhonetics.h"
#include "MusicManagment/database/duplicates/DuplicateSearch.h"
#include "MusicManagment/database/duplicates/SimilarArtists.h"
#include "tests/PlainDistance.h"

using namespace Qt::StringLiterals;

namespace {

using Match = TextBlocks::Match;

// Texts of all lengths up to `longest`, one in two made of an earlier one by some edits.
ComparedTexts MakeTexts(std::size_t count, std::size_t longest, QStringView letters, std::mt19937& random) {
    const auto below = [&random](auto limit) { return random() % static_cast<std::uint32_t>(limit); };
    const auto letter = [&] { return letters[below(letters.size())]; };
    std::vector<QString> made;
    ComparedTexts texts;
    while (made.size() < count) {
        QString text;
        if (made.empty() || below(2) == 0) {
            for (std::size_t length = below(longest + 1); length > 0; --length)
                text += letter();
        } else {
            text = made[below(made.size())];
            for (std::size_t edits = below(static_cast<std::size_t>(text.size()) / 2 + 2); edits > 0;
                 --edits) {
                const auto place = static_cast<qsizetype>(below(text.size() + 1));
                const auto kind = below(3);
                if (kind == 0 && text.size() < static_cast<qsizetype>(longest)) text.insert(place, letter());
                if (kind == 1) text.remove(place, 1);
                if (kind == 2 && place < text.size()) text[place] = letter();
            }
        }
        texts.Add(text);
        made.push_back(text);
    }
    texts.Classify();
    return texts;
}

std::vector<Match> PlainMatches(const ComparedTexts& texts, std::uint32_t reference, int percent) {
    std::vector<Match> matches;
    for (std::uint32_t i = 0; i < texts.Count(); ++i) {
        const std::size_t longer = std::max(texts.Length(reference), texts.Length(i));
        const std::size_t distance = PlainDistance(texts.Text(reference), texts.Text(i));
        if (100 * distance <= static_cast<std::size_t>(100 - percent) * longer)
            matches.push_back({i, static_cast<std::uint32_t>(distance)});
    }
    return matches;
}

TEST(PairSearch, EveryWayOfComparingFindsWhatTheDefinitionTells) {
    std::mt19937 random(7);
    const QString many = u"abcdefghijklmnopqrstuvwxyz 0123456789-'äöüßéабвгдежзийклмнопрст日本語"_s;
    for (const std::size_t longest : {14u, 39u, 43u, 81u, 130u, 190u})
        for (const QString& letters : {u"abc"_s, many})
            for (const int percent : {60, 85}) {
                const ComparedTexts texts = MakeTexts(96, longest, letters, random);
                std::vector<std::uint32_t> numbers(texts.Count());
                std::iota(numbers.begin(), numbers.end(), 0);
                TextBlocks::OrderForBlocks(texts, numbers);
                for (std::uint32_t reference = 0; reference < texts.Count(); reference += 12) {
                    const auto expected = PlainMatches(texts, reference, percent);
                    for (const LaneKernels& kernels : ProcessorLanes()) {
                        TextBlocks::Workspace workspace;
                        const TextBlocks blocks(texts, numbers, percent, kernels);
                        ASSERT_EQ(blocks.MatchesOf(reference, workspace), expected)
                            << longest << ' ' << percent;
                    }
                }
            }
}

TEST(PairSearch, PairsComeOnceInTheOrderOfTheReferences) {
    ComparedTexts texts;
    for (const QString& text :
         {u"Abba"_s, u"ABBA"_s, u"Queen"_s, u"abbas"_s, u""_s, u""_s, u"A\u0308bba"_s, u"äbba"_s})
        texts.Add(text);
    texts.Classify();
    const auto rows = [&texts](std::vector<std::uint32_t> groups, std::vector<std::uint32_t> references) {
        std::vector<std::array<std::uint32_t, 3>> found;
        SearchPairs(
            {.Texts = &texts,
             .Groups = std::move(groups),
             .References = std::move(references),
             .Percent = 80},
            [&](std::uint32_t reference, std::span<const Match> matches) {
                for (const Match& match : matches)
                    found.push_back({reference, match.Number, match.Distance});
                return found.size() < 3;
            },
            [] { return true; });
        return found;
    };
    using Rows = std::vector<std::array<std::uint32_t, 3>>;
    EXPECT_EQ(rows({}, {1, 3}), (Rows{{1, 0, 0}, {1, 3, 1}, {3, 0, 1}}));  // that of 1 and 3 is told once
    EXPECT_EQ(rows({}, {4, 5, 6, 7}), (Rows{{4, 5, 0}, {6, 7, 0}}));
    EXPECT_EQ(rows({0, 1, 0, 1, 0, 0, 0, 0}, {0, 1, 2, 3}), (Rows{{1, 3, 1}}));
    EXPECT_EQ(rows({}, {0, 1, 2, 3, 4, 5}), (Rows{{0, 1, 0}, {0, 3, 1}, {1, 3, 1}}));  // ended there
}

TEST(Duplicates, ComeInTheOrderOfTheCollectionByNameOrWithinAnArtist) {
    TMusicDatabase database;
    const auto add = [&database](const QString& path, const QString& artist, const QString& title) {
        TID3Tag song;
        song.Artist = artist;
        song.Title = title;
        const SongIndex index = database.AddEntry(path, song, AddAs::Returning);
        return database.Songs().HandleOf(index);
    };
    database.SetSortType(stPath);
    const SongHandle a = add(u"/m/1.mp3"_s, u"Queen"_s, u"Innuendo"_s);
    const SongHandle b = add(u"/m/2.mp3"_s, u"QUEEN"_s, u"innuendo"_s);
    const SongHandle c = add(u":12AB34CD:\\3.mp3"_s, u"Queen"_s, u"Innuendos"_s);
    const SongHandle d = add(u"/m/4.mp3"_s, u"Other"_s, u"Innuendo"_s);
    const auto rows = [&database](const DuplicateQuery& query) {
        DuplicateRows found;
        EXPECT_EQ(FindDuplicates(database, query, found), DuplicateEnd::Done);
        std::vector<std::pair<SongHandle, SongHandle>> pairs;
        for (std::size_t row = 0; row < found.Count(); ++row)
            pairs.emplace_back(found.At(row).First, found.At(row).Second);
        return pairs;
    };
    using Pairs = std::vector<std::pair<SongHandle, SongHandle>>;
    EXPECT_EQ(rows({.SameArtistOnly = true}), (Pairs{{a, b}, {a, c}, {b, c}}));
    EXPECT_EQ(rows({.LeastPercent = 100}), (Pairs{{a, b}}));
    EXPECT_EQ(rows({.References = {b}, .LeastPercent = 90}), (Pairs{{b, a}, {b, c}}));
    EXPECT_EQ(rows({.References = {d, b}, .AmongReferencesOnly = true}), (Pairs{{b, d}}));
    EXPECT_EQ(SimilarityText(100), u"100%"_s);
    EXPECT_EQ(SimilarityText(94.1176), u" 94.1"_s);
    EXPECT_EQ(ComparedName(*database.Songs().Find(c), false), u"[CD] queen - innuendos"_s);
}

TEST(SimilarArtists, AreAlikeOrSoundAlike) {
    for (const auto& [name, code] : {std::pair{u"Müller-Lüdenscheidt"_s, "65752682"},
                                     {u"Breschnew"_s, "17863"},
                                     {u"Wikipedia"_s, "3412"},
                                     {u"Xaver Cüche"_s, "483744"},
                                     {u"Phil 2"_s, "35c"},
                                     {u"東京"_s, ""}})
        EXPECT_EQ(ColognePhonetics(name), code) << name.toStdString();
    TMusicDatabase database;
    for (const QString& artist :
         {u"Beatles"_s, u"The Beatles"_s, u"Meier"_s, u"Mayr"_s, u"Xyz"_s, u"Xyz"_s}) {
        TID3Tag song;
        song.Artist = artist;
        database.AddEntry(u"/m/%1"_s.arg(database.Count()), song, AddAs::Returning);
    }
    bool stopped = false;
    const auto pairs = FindSimilarArtists(database, stopped);
    ASSERT_EQ(pairs.size(), 2u);
    EXPECT_TRUE(pairs[0].First == u"Beatles"_s && pairs[0].Second == u"The Beatles"_s);
    EXPECT_TRUE(pairs[1].First == u"Mayr"_s && pairs[1].Second == u"Meier"_s);  // 40 percent
}

}  // namespace
