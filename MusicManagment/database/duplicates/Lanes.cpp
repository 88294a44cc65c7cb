#include "MusicManagment/database/duplicates/LaneKernel.h"

namespace {

struct OneLane : PlainBits {
    using Word = std::uint64_t;
    using Vector = Word;
    static constexpr int kWidth = 1;

    static Vector Load(const LaneColumns& columns, int lane) {
        return columns.Letters[static_cast<std::size_t>(lane)];
    }
    static Vector Second(Vector letters) { return letters >> 8; }
    static Vector Find(const LaneRow<Word>& row, Vector letters) {
        return row.Places[letters % kLetterClasses];
    }
    static Vector All(Word word) { return word; }
    static Vector CountUp(Vector counts, Vector vector, Vector bit) {
        return counts + ((vector & bit) == 0 ? 1 : 0);
    }
    static Vector Least(Vector a, Vector b) { return a < b ? a : b; }
    static void Store(Vector counts, std::uint16_t* distances) {
        *distances = static_cast<std::uint16_t>(counts);
    }
    static std::uint64_t Within(Vector counts, int limit) {
        return counts <= static_cast<Vector>(limit) ? 1 : 0;
    }
};

std::vector<LaneKernels> LanesOfProcessor() {
    std::vector<LaneKernels> lanes;
#ifdef TUNESTEAD_LANES
    if (__builtin_cpu_supports("avx512bw") != 0) lanes.push_back(kAvx512Lanes);
    if (__builtin_cpu_supports("avx2") != 0) lanes.push_back(kAvx2Lanes);
#endif
    lanes.push_back({});
    return lanes;
}

}  // namespace

std::uint64_t WideLanes(const LaneTask& task, const LaneRow<std::uint64_t>* rows) {
    return AllLanesWithin<OneLane, 1>(task, rows);
}

const std::vector<LaneKernels>& ProcessorLanes() {
    static const std::vector<LaneKernels> lanes = LanesOfProcessor();
    return lanes;
}
