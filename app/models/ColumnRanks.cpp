#include "app/models/ColumnRanks.h"

#include <QHash>
#include <QStringList>
#include <algorithm>
#include <numeric>

#include "CommonRUKTools/Collation.h"

namespace {

// Texts by their number, each once, in the order in which they came.
struct DistinctTexts {
    QStringList Texts;
    std::vector<int> NumberOfSong;
};

DistinctTexts Distinguish(const SongColumn& column, const std::vector<const TID3Tag*>& songs) {
    DistinctTexts distinct;
    distinct.NumberOfSong.reserve(songs.size());
    QHash<QString, int> numbers;
    for (const TID3Tag* song : songs) {
        const QString text = column.Text(*song);
        const auto known = numbers.constFind(text);
        if (known != numbers.constEnd()) {
            distinct.NumberOfSong.push_back(*known);
            continue;
        }
        const int next = static_cast<int>(distinct.Texts.size());
        numbers.insert(text, next);
        distinct.NumberOfSong.push_back(next);
        distinct.Texts << text;
    }
    return distinct;
}

std::vector<int> RanksOf(const QStringList& texts) {
    QCollator collator = Collation::CaseInsensitive();
    collator.setNumericMode(true);
    std::vector<int> order(static_cast<std::size_t>(texts.size()));
    std::iota(order.begin(), order.end(), 0);
    std::ranges::stable_sort(order, [&](int a, int b) { return collator.compare(texts[a], texts[b]) < 0; });
    std::vector<int> ranks(order.size());
    for (std::size_t rank = 0; rank < order.size(); ++rank)
        ranks[static_cast<std::size_t>(order[rank])] = static_cast<int>(rank);
    return ranks;
}

}  // namespace

// The columns have few different texts for many songs, so that only those few are compared as texts.
std::vector<int> ColumnRanks(const SongColumn& column, const std::vector<const TID3Tag*>& songs) {
    DistinctTexts distinct = Distinguish(column, songs);
    const std::vector<int> ranks = RanksOf(distinct.Texts);
    for (int& number : distinct.NumberOfSong)
        number = ranks[static_cast<std::size_t>(number)];
    return std::move(distinct.NumberOfSong);
}
