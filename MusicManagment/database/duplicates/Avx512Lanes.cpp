// GCC 12 takes what its own header leaves undefined on purpose for a mistake of ours.
#if defined(__GNUC__) && !defined(__clang__)
#pragma GCC diagnostic ignored "-Wmaybe-uninitialized"
#endif

#include <immintrin.h>

#include "MusicManagment/database/duplicates/LaneKernel.h"

namespace {

// One instruction for any function of three bits.
template <typename Vector>
struct TernaryBits {
    template <int kTable>
    static Vector Of(Vector a, Vector b, Vector c) {
        return reinterpret_cast<Vector>(_mm512_ternarylogic_epi32(reinterpret_cast<__m512i>(a),
                                                                  reinterpret_cast<__m512i>(b),
                                                                  reinterpret_cast<__m512i>(c), kTable));
    }
    static Vector Across(Vector diagonal, Vector up, Vector down) { return Of<0xE3>(diagonal, up, down); }
    static Vector Up(Vector across, Vector up, Vector below) { return Of<0xC5>(across, up, below); }
    static Vector Down(Vector across, Vector up, Vector below) { return Of<0x20>(across, up, below); }
};

using ShortVector = std::uint16_t __attribute__((vector_size(64)));
using LongVector = std::uint32_t __attribute__((vector_size(64)));

struct ShortVectors : TernaryBits<ShortVector> {
    using Word = std::uint16_t;
    using Vector = ShortVector;
    static constexpr int kWidth = 32;

    static Vector Load(const LaneColumns& columns, int lane) {
        return reinterpret_cast<Vector>(_mm512_load_si512(columns.Letters.data() + lane));
    }
    static Vector Second(Vector letters) { return letters >> 8; }
    // Only the lower five bits of a letter's word count.
    static Vector Find(const LaneRow<Word>& row, Vector letters) {
        return reinterpret_cast<Vector>(_mm512_permutexvar_epi16(reinterpret_cast<__m512i>(letters),
                                                                 _mm512_load_si512(row.Places.data())));
    }
    static Vector All(Word word) {
        return reinterpret_cast<Vector>(_mm512_set1_epi16(static_cast<short>(word)));
    }
    static Vector CountUp(Vector counts, Vector vector, Vector bit) {
        const __mmask32 unset =
            _mm512_testn_epi16_mask(reinterpret_cast<__m512i>(vector), reinterpret_cast<__m512i>(bit));
        const __m512i old = reinterpret_cast<__m512i>(counts);
        return reinterpret_cast<Vector>(_mm512_mask_add_epi16(old, unset, old, _mm512_set1_epi16(1)));
    }
    static Vector Least(Vector a, Vector b) {
        return reinterpret_cast<Vector>(
            _mm512_min_epu16(reinterpret_cast<__m512i>(a), reinterpret_cast<__m512i>(b)));
    }
    static void Store(Vector counts, std::uint16_t* distances) {
        _mm512_storeu_si512(distances, reinterpret_cast<__m512i>(counts));
    }
    static std::uint64_t Within(Vector counts, int limit) {
        return _mm512_cmple_epu16_mask(reinterpret_cast<__m512i>(counts),
                                       _mm512_set1_epi16(static_cast<short>(limit)));
    }
};

struct LongVectors : TernaryBits<LongVector> {
    using Word = std::uint32_t;
    using Vector = LongVector;
    static constexpr int kWidth = 16;

    static Vector Load(const LaneColumns& columns, int lane) {
        const auto* words = reinterpret_cast<const __m256i*>(columns.Letters.data() + lane);
        return reinterpret_cast<Vector>(_mm512_cvtepu16_epi32(_mm256_load_si256(words)));
    }
    static Vector Second(Vector letters) { return letters >> 8; }
    static Vector Find(const LaneRow<Word>& row, Vector letters) {
        return reinterpret_cast<Vector>(_mm512_permutex2var_epi32(_mm512_load_si512(row.Places.data()),
                                                                  reinterpret_cast<__m512i>(letters),
                                                                  _mm512_load_si512(row.Places.data() + 16)));
    }
    static Vector All(Word word) {
        return reinterpret_cast<Vector>(_mm512_set1_epi32(static_cast<int>(word)));
    }
    static Vector CountUp(Vector counts, Vector vector, Vector bit) {
        const __mmask16 unset =
            _mm512_testn_epi32_mask(reinterpret_cast<__m512i>(vector), reinterpret_cast<__m512i>(bit));
        const __m512i old = reinterpret_cast<__m512i>(counts);
        return reinterpret_cast<Vector>(_mm512_mask_add_epi32(old, unset, old, _mm512_set1_epi32(1)));
    }
    static Vector Least(Vector a, Vector b) {
        return reinterpret_cast<Vector>(
            _mm512_min_epu32(reinterpret_cast<__m512i>(a), reinterpret_cast<__m512i>(b)));
    }
    static void Store(Vector counts, std::uint16_t* distances) {
        _mm256_storeu_si256(reinterpret_cast<__m256i*>(distances),
                            _mm512_cvtepi32_epi16(reinterpret_cast<__m512i>(counts)));
    }
    static std::uint64_t Within(Vector counts, int limit) {
        return _mm512_cmple_epu32_mask(reinterpret_cast<__m512i>(counts), _mm512_set1_epi32(limit));
    }
};

}  // namespace

const LaneKernels kAvx512Lanes = {&AllLanesWithin<ShortVectors, 2>, &AllLanesWithin<LongVectors, 2>};
