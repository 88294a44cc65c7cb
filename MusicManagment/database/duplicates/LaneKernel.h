#pragma once

#include "MusicManagment/database/duplicates/Lanes.h"

// The comparison itself, for any kind of vectors. `Vectors` gives the type Vector of lanes of the type Word,
// the number of lanes kWidth, and:
//   Load(columns, first lane): two columns of kWidth texts, the first in the low bytes
//   Second(letters): the second of them
//   Find(row, letters): the places of each lane's letter
//   OrNeither(a, b, c): a | ~(b | c)
//   All(word), CountUp(counts, vector, bit): one more where the bit is not set
//   Within(counts, limit): a bit a lane

// Hyyrö's bit-parallel distance within a band (A bit-vector algorithm for computing Levenshtein and Damerau
// edit distances, 2003): a word holds the differences of neighbouring rows for the band's part of a column,
// and goes down one row with each column, so that each of its bits stays on one diagonal. The value on the
// diagonal through the end is counted; it never falls, so that a look at it tells when all lanes are beyond
// the limit.
template <typename Vectors, int kVectors>
struct LaneGroup {
    using Vector = typename Vectors::Vector;

    Vector Up[kVectors];    // rows that are one more than the row above
    Vector Down[kVectors];  // rows that are one less
    Vector Count[kVectors];

    void Begin(const LaneBand& band) {
        const int start = band.Target > band.Above ? band.Target - band.Above : 0;
        for (int i = 0; i < kVectors; ++i) {
            Up[i] =
                Vectors::All(static_cast<typename Vectors::Word>(~typename Vectors::Word{0} << band.Above));
            Down[i] = Vectors::All(0);
            Count[i] = Vectors::All(static_cast<typename Vectors::Word>(start));
        }
    }

    void Step(int i, Vector equal, Vector target) {
        const Vector diagonal = (((equal & Up[i]) + Up[i]) ^ Up[i]) | equal | Down[i];
        const Vector right = Vectors::OrNeither(Down[i], diagonal, Up[i]);
        const Vector left = diagonal & Up[i];
        Count[i] = Vectors::CountUp(Count[i], diagonal, target);
        const Vector below = diagonal >> 1;
        Up[i] = Vectors::OrNeither(left, below, right);
        Down[i] = below & right;
    }
};

// kVectors at a time, which hides how long each step takes.
template <typename Vectors, int kVectors>
std::uint64_t LanesWithin(const LaneTask& task, const LaneRow<typename Vectors::Word>* rows, int firstLane) {
    using Word = typename Vectors::Word;
    constexpr int kBits = static_cast<int>(8 * sizeof(Word));
    const LaneBand band = BandOf(task);
    const auto target = Vectors::All(static_cast<Word>(Word{1} << band.Target));
    LaneGroup<Vectors, kVectors> group;
    group.Begin(band);
    const auto within = [&] {
        std::uint64_t lanes = 0;
        for (int i = 0; i < kVectors; ++i)
            lanes |= Vectors::Within(group.Count[i], task.Limit) << (i * Vectors::kWidth);
        return lanes;
    };
    const LaneRow<Word>* row = rows + (kBits - band.Above);
    const LaneColumns* columns = task.Columns;
    // Before so many columns nothing can be beyond the limit.
    const int mostLeft = task.Length - task.Limit;
    typename Vectors::Vector letters[kVectors] = {};
    const auto step = [&] {
        for (int i = 0; i < kVectors; ++i)
            group.Step(i, Vectors::Find(*row, letters[i]), target);
        ++row;
    };
    for (int left = task.Length; left > 0; left -= 2, ++columns) {
        for (int i = 0; i < kVectors; ++i)
            letters[i] = Vectors::Load(*columns, firstLane + i * Vectors::kWidth);
        step();
        if (left == 1) break;
        for (int i = 0; i < kVectors; ++i)
            letters[i] = Vectors::Second(letters[i]);
        step();
        if (left < mostLeft && within() == 0) return 0;
    }
    return within() << firstLane;
}

template <typename Vectors, int kVectors>
std::uint64_t AllLanesWithin(const LaneTask& task, const LaneRow<typename Vectors::Word>* rows) {
    std::uint64_t lanes = 0;
    for (int lane = 0; lane < task.Count; lane += kVectors * Vectors::kWidth)
        lanes |= LanesWithin<Vectors, kVectors>(task, rows, lane);
    return lanes;
}
