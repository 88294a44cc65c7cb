#include <immintrin.h>

#include "MusicManagment/database/duplicates/LaneKernel.h"

namespace {

struct ShortVectors : PlainBits {
    using Word = std::uint16_t;
    using Vector = std::uint16_t __attribute__((vector_size(32)));
    static constexpr int kWidth = 16;

    static Vector Load(const LaneColumns& columns, int lane) {
        return reinterpret_cast<Vector>(
            _mm256_load_si256(reinterpret_cast<const __m256i*>(columns.Letters.data() + lane)));
    }
    static Vector Second(Vector letters) { return letters >> 8; }
    // Sixteen words are looked up as twice eight double words, of which the lower half counts.
    static Vector Find(const LaneRow<Word>& row, Vector letters) {
        const auto* places = reinterpret_cast<const int*>(row.Places.data());
        const __m256i classes = _mm256_and_si256(reinterpret_cast<__m256i>(letters), _mm256_set1_epi16(31));
        const __m256i low = _mm256_and_si256(classes, _mm256_set1_epi32(0xFFFF));
        const __m256i high = _mm256_srli_epi32(classes, 16);
        const __m256i lowPlaces = _mm256_i32gather_epi32(places, low, sizeof(Word));
        const __m256i highPlaces = _mm256_i32gather_epi32(places, high, sizeof(Word));
        return reinterpret_cast<Vector>(
            _mm256_blend_epi16(lowPlaces, _mm256_slli_epi32(highPlaces, 16), 0xAA));
    }
    static Vector All(Word word) {
        return reinterpret_cast<Vector>(_mm256_set1_epi16(static_cast<short>(word)));
    }
    static Vector CountUp(Vector counts, Vector vector, Vector bit) {
        const __m256i unset =
            _mm256_cmpeq_epi16(reinterpret_cast<__m256i>(vector & bit), _mm256_setzero_si256());
        return counts - reinterpret_cast<Vector>(unset);
    }
    static Vector Least(Vector a, Vector b) {
        return reinterpret_cast<Vector>(
            _mm256_min_epu16(reinterpret_cast<__m256i>(a), reinterpret_cast<__m256i>(b)));
    }
    static void Store(Vector counts, std::uint16_t* distances) {
        _mm256_storeu_si256(reinterpret_cast<__m256i*>(distances), reinterpret_cast<__m256i>(counts));
    }
    static std::uint64_t Within(Vector counts, int limit) {
        const __m256i beyond = _mm256_cmpgt_epi16(reinterpret_cast<__m256i>(counts),
                                                  _mm256_set1_epi16(static_cast<short>(limit)));
        // To bytes, whose order the packing of halves has mixed up.
        const __m256i bytes =
            _mm256_permute4x64_epi64(_mm256_packs_epi16(beyond, _mm256_setzero_si256()), 0xD8);
        return ~static_cast<std::uint32_t>(_mm256_movemask_epi8(bytes)) & 0xFFFF;
    }
};

struct LongVectors : PlainBits {
    using Word = std::uint32_t;
    using Vector = std::uint32_t __attribute__((vector_size(32)));
    static constexpr int kWidth = 8;

    static Vector Load(const LaneColumns& columns, int lane) {
        const auto* words = reinterpret_cast<const __m128i*>(columns.Letters.data() + lane);
        return reinterpret_cast<Vector>(_mm256_cvtepu16_epi32(_mm_load_si128(words)));
    }
    static Vector Second(Vector letters) { return letters >> 8; }
    static Vector Find(const LaneRow<Word>& row, Vector letters) {
        const __m256i classes = _mm256_and_si256(reinterpret_cast<__m256i>(letters), _mm256_set1_epi32(31));
        const auto* places = reinterpret_cast<const int*>(row.Places.data());
        return reinterpret_cast<Vector>(_mm256_i32gather_epi32(places, classes, sizeof(Word)));
    }
    static Vector All(Word word) {
        return reinterpret_cast<Vector>(_mm256_set1_epi32(static_cast<int>(word)));
    }
    static Vector CountUp(Vector counts, Vector vector, Vector bit) {
        const __m256i unset =
            _mm256_cmpeq_epi32(reinterpret_cast<__m256i>(vector & bit), _mm256_setzero_si256());
        return counts - reinterpret_cast<Vector>(unset);
    }
    static Vector Least(Vector a, Vector b) {
        return reinterpret_cast<Vector>(
            _mm256_min_epu32(reinterpret_cast<__m256i>(a), reinterpret_cast<__m256i>(b)));
    }
    static void Store(Vector counts, std::uint16_t* distances) {
        const __m256i words = reinterpret_cast<__m256i>(counts);
        const __m256i packed = _mm256_permute4x64_epi64(_mm256_packus_epi32(words, words), 0xD8);
        _mm_storeu_si128(reinterpret_cast<__m128i*>(distances), _mm256_castsi256_si128(packed));
    }
    static std::uint64_t Within(Vector counts, int limit) {
        const __m256i beyond =
            _mm256_cmpgt_epi32(reinterpret_cast<__m256i>(counts), _mm256_set1_epi32(limit));
        return ~static_cast<std::uint32_t>(_mm256_movemask_ps(_mm256_castsi256_ps(beyond))) & 0xFF;
    }
};

}  // namespace

const LaneKernels kAvx2Lanes = {&AllLanesWithin<ShortVectors, 4>, &AllLanesWithin<LongVectors, 4>};
