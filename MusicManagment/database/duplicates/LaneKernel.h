#pragma once

#include "MusicManagment/database/duplicates/Lanes.h"

// The comparison itself, for any kind of vectors. `Vectors` gives the type Vector of lanes of the type Word,
// the number of lanes kWidth, and:
//   Load(columns, first lane): two columns of kWidth texts, the first in the low bytes
//   Second(letters): the second of them
//   Find(row, letters): the places of each lane's letter
//   Across, Up, Down: those of PlainBits
//   All(word), CountUp(counts, vector, bit): one more where the bit is not set
//   Least(a, b), Within(counts, limit): a bit a lane
//   Store(counts, distances): those of kWidth texts

// What a step makes of three words, for vectors without an instruction of three operands.
struct PlainBits {
    // Where the value differs from the one to the left: it is less where `up` is set, else more.
    template <typename Vector>
    static Vector Across(Vector diagonal, Vector up, Vector down) {
        return (diagonal & up) | ~(up | (diagonal & ~down));
    }
    template <typename Vector>
    static Vector Up(Vector across, Vector up, Vector below) {
        return (across & up) | ~(across | below);
    }
    template <typename Vector>
    static Vector Down(Vector across, Vector up, Vector below) {
        return across & ~up & below;
    }
};

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
        const Vector diagonal = (((equal & Up[i]) + Up[i]) ^ Up[i]) | (equal | Down[i]);
        const Vector across = Vectors::Across(diagonal, Up[i], Down[i]);
        Count[i] = Vectors::CountUp(Count[i], diagonal, target);
        const Vector below = diagonal >> 1;
        Down[i] = Vectors::Down(across, Up[i], below);
        Up[i] = Vectors::Up(across, Up[i], below);
    }

    bool IsAnyWithin(int limit) const {
        Vector least = Count[0];
        for (int i = 1; i < kVectors; ++i)
            least = Vectors::Least(least, Count[i]);
        return Vectors::Within(least, limit) != 0;
    }

    // A bit a lane; their distances are stored.
    std::uint64_t Within(int limit, std::uint16_t* distances) const {
        std::uint64_t lanes = 0;
        for (int i = 0; i < kVectors; ++i) {
            lanes |= Vectors::Within(Count[i], limit) << (i * Vectors::kWidth);
            Vectors::Store(Count[i], distances + i * Vectors::kWidth);
        }
        return lanes;
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
        if (left < mostLeft && !group.IsAnyWithin(task.Limit)) return 0;
    }
    return group.Within(task.Limit, task.Distances + firstLane) << firstLane;
}

template <typename Vectors, int kVectors>
std::uint64_t AllLanesWithin(const LaneTask& task, const LaneRow<typename Vectors::Word>* rows) {
    std::uint64_t lanes = 0;
    for (int lane = 0; lane < task.Count; lane += kVectors * Vectors::kWidth)
        lanes |= LanesWithin<Vectors, kVectors>(task, rows, lane);
    return lanes;
}
