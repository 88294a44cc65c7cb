// Any bytes are texts that are compared with each other: every way of comparing that this processor has finds
// what the definition of the distance tells.
//   percentage (8 bit), which letters (8 bit), then texts, ended by line feeds
// Letters are either the bytes themselves, few of them, so that texts are often alike; or the bytes as UTF-8.

#include <QList>
#include <QString>
#include <algorithm>
#include <cstdlib>
#include <numeric>

#include "MusicManagment/database/duplicates/TextBlocks.h"
#include "tests/PlainDistance.h"

namespace {

using Match = TextBlocks::Match;

// As many as fill more than one block of lanes; more letters would only take longer.
constexpr std::size_t kMostTexts = 80;
constexpr std::size_t kMostLetters = 1500;
constexpr std::size_t kReferences = 4;

QString TextOf(QByteArray bytes, std::uint8_t alphabet) {
    if (alphabet == 0) return QString::fromUtf8(bytes);
    for (char& letter : bytes)
        letter = static_cast<char>('a' + static_cast<std::uint8_t>(letter) % (alphabet % 40 + 1));
    return QString::fromLatin1(bytes);
}

ComparedTexts TextsOf(const QByteArray& input, std::uint8_t alphabet) {
    ComparedTexts texts;
    std::size_t letters = 0;
    for (const QByteArray& line : input.split('\n')) {
        const QString text = TextOf(line, alphabet);
        letters += static_cast<std::size_t>(text.size());
        if (texts.Count() == kMostTexts || letters > kMostLetters) break;
        texts.Add(text);
    }
    texts.Classify();
    return texts;
}

std::vector<Match> PlainMatches(const ComparedTexts& texts, std::uint32_t reference, int percent) {
    std::vector<Match> matches;
    for (std::uint32_t number = 0; number < texts.Count(); ++number) {
        const std::size_t longer = std::max(texts.Length(reference), texts.Length(number));
        const std::size_t distance = PlainDistance(texts.Text(reference), texts.Text(number));
        if (100 * distance <= static_cast<std::size_t>(100 - percent) * longer)
            matches.push_back({number, static_cast<std::uint32_t>(distance)});
    }
    return matches;
}

void Check(const ComparedTexts& texts, int percent) {
    std::vector<std::uint32_t> numbers(texts.Count());
    std::iota(numbers.begin(), numbers.end(), 0);
    TextBlocks::OrderForBlocks(texts, numbers);
    TextBlocks::Workspace workspace;  // one for all, as the search has it
    const std::size_t step = texts.Count() / kReferences + 1;
    for (const LaneKernels& kernels : ProcessorLanes()) {
        const TextBlocks blocks(texts, numbers, percent, kernels);
        for (std::size_t reference = 0; reference < texts.Count(); reference += step) {
            const auto number = static_cast<std::uint32_t>(reference);
            if (blocks.MatchesOf(number, workspace) != PlainMatches(texts, number, percent)) std::abort();
        }
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    if (size < 2) return 0;
    const QByteArray input(reinterpret_cast<const char*>(data + 2), static_cast<qsizetype>(size - 2));
    const ComparedTexts texts = TextsOf(input, data[1]);
    if (texts.Count() > 0) Check(texts, data[0] % 100 + 1);
    return 0;
}
