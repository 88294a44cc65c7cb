// Compares the names of 65,536 songs with each other, as the search for duplicates does, and the peers the
// names of some of them with all: rows, seconds, and pairs a second of processor time. Arguments: number of
// songs, "names" or "equal" or "length" (all of 40 letters) for what they are called.

#include <cstdio>
#include <cstdlib>
#include <ctime>
#include <numeric>

#include "CommonRUKTools/CompStr.h"
#include "MusicManagment/database/duplicates/PairSearch.h"
#include "bench/SongNames.h"

#ifdef TUNESTEAD_RAPIDFUZZ
#include <rapidfuzz/distance/Levenshtein.hpp>
#endif

using namespace Qt::StringLiterals;

namespace {

constexpr std::size_t kPeerReferences = 400;

QString NameOf(int song, std::string_view kind) {
    if (kind == "equal") return u"the same - name"_s;
    const QString name = SongNames::Artist(song / 12) + u" - "_s + SongNames::Title(song);
    if (kind != "length") return name;
    return (name + u' ' + SongNames::Title(song + 1) + u' ' + SongNames::Title(song + 2)).left(40);
}

// Processor time of this program, of all its threads, s.
double ProcessorSeconds() {
    return static_cast<double>(std::clock()) / CLOCKS_PER_SEC;
}

void Tell(const char* what, std::size_t rows, double pairs, double seconds, double processor) {
    std::printf("%-22s %12zu rows %8.2f s %8.2f s of processor %8.1f million pairs/s\n", what, rows, seconds,
                processor, pairs / processor / 1e6);
}

double Now() {
    timespec time{};
    clock_gettime(CLOCK_MONOTONIC, &time);
    return static_cast<double>(time.tv_sec) + static_cast<double>(time.tv_nsec) / 1e9;
}

// `compare` tells how many rows a reference has.
template <typename Compare>
void MeasurePeer(const char* what, const ComparedTexts& texts, Compare compare) {
    const std::size_t references = std::min(kPeerReferences, texts.Count());
    const double start = Now();
    const double processor = ProcessorSeconds();
    std::size_t rows = 0;
    for (std::size_t i = 0; i < references; ++i)
        rows += compare(i * texts.Count() / references);
    const double pairs = static_cast<double>(references) * static_cast<double>(texts.Count());
    Tell(what, rows, pairs, Now() - start, ProcessorSeconds() - processor);
}

void MeasureSearch(const char* what, const ComparedTexts& texts, int threads) {
    PairQuery query{.Texts = &texts, .Threads = threads};
    query.References.resize(texts.Count());
    std::iota(query.References.begin(), query.References.end(), 0);
    const double start = Now();
    const double processor = ProcessorSeconds();
    std::size_t rows = 0;
    const auto found = [&rows](std::uint32_t, auto matches) {
        rows += matches.size();
        return rows < 20'000'000;
    };
    const bool isWhole = SearchPairs(query, found, [] { return true; });
    const auto count = static_cast<double>(texts.Count());
    Tell(what, rows, isWhole ? count * (count - 1) / 2 : static_cast<double>(rows), Now() - start,
         ProcessorSeconds() - processor);
}

std::size_t PlainRows(const ComparedTexts& texts, std::size_t reference) {
    std::size_t rows = 0;
    for (std::size_t i = 0; i < texts.Count(); ++i) {
        const std::size_t longer = std::max(texts.Length(reference), texts.Length(i));
        if (IsAlike(EditDistance(texts.Text(reference), texts.Text(i)), longer)) ++rows;
    }
    return rows;
}

#ifdef TUNESTEAD_RAPIDFUZZ
std::size_t RapidfuzzRows(const ComparedTexts& texts, std::size_t reference) {
    const auto text = texts.Text(reference);
    const rapidfuzz::CachedLevenshtein<char32_t> cached(text.begin(), text.end());
    std::size_t rows = 0;
    for (std::size_t i = 0; i < texts.Count(); ++i) {
        const auto other = texts.Text(i);
        if (cached.normalized_similarity(other.begin(), other.end(), 0.6) >= 0.6) ++rows;
    }
    return rows;
}
#endif

}  // namespace

int main(int argc, char** argv) {
    const int count = argc > 1 ? std::atoi(argv[1]) : 65536;
    const std::string_view kind = argc > 2 ? argv[2] : "names";
    ComparedTexts texts;
    for (int song = 0; song < count; ++song)
        texts.Add(NameOf(song, kind));
    texts.Classify();
    MeasureSearch("search, one thread", texts, 1);
    MeasureSearch("search, all threads", texts, 0);
    MeasurePeer("one by one", texts, [&](std::size_t reference) { return PlainRows(texts, reference); });
#ifdef TUNESTEAD_RAPIDFUZZ
    MeasurePeer("rapidfuzz, one thread", texts,
                [&](std::size_t reference) { return RapidfuzzRows(texts, reference); });
#endif
    return 0;
}
