#include <QString>
#include <chrono>
#include <cstdio>
#include <cstdlib>

#include "MusicManagment/database/duplicates/PairSearch.h"
#include "bench/ProcessorTime.h"
#include "bench/SongNames.h"

int main(int argc, char** argv) {
    const int count = argc > 1 ? std::atoi(argv[1]) : 65536;
    ComparedTexts texts;
    for (int i = 0; i < count; ++i)
        texts.Add(SongNames::Artist(i / 12) + QStringLiteral(" - ") + SongNames::Title(i));
    texts.Classify();
    PairQuery query{.Texts = &texts};
    for (int i = 0; i < (argc > 2 ? std::atoi(argv[2]) : count); ++i) query.References.push_back(static_cast<std::uint32_t>(i));
    query.Threads = argc > 3 ? std::atoi(argv[3]) : 0;
    const auto start = std::chrono::steady_clock::now();
    const auto cpu = std::clock();
    std::size_t rows = 0;
    SearchPairs(query, [&](std::uint32_t, auto matches) { rows += matches.size(); return true; }, [] { return true; });
    const double pairs = double(query.References.size()) * (count - double(query.References.size()) / 2);
    const double seconds = double(std::clock() - cpu) / CLOCKS_PER_SEC;
    std::printf("%zu rows, %.2f s, cpu %.2f s, %.1f Mpairs/s\n", rows, std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count(), seconds, pairs / seconds / 1e6);
}
