#pragma once

// Vectors as wide as the registers of the processor that this is compiled for, and the few
// operations on them that the language does not have. Part of the ray loops, see Lanes.h.

#include <immintrin.h>

#include <cstdint>

namespace quarn {
namespace {

#if defined(__AVX512F__) && defined(__AVX512DQ__)

constexpr int native_lanes = 16;
typedef float NativeFloats __attribute__((vector_size(64)));
typedef std::int32_t NativeInts __attribute__((vector_size(64)));

// The forms with a mask, of all lanes: in the others GCC 12 warns of an operand without a value.
inline NativeFloats nativeRoot(NativeFloats a) {
    return _mm512_maskz_sqrt_ps(0xFFFF, a);
}
inline NativeFloats nativeLeast(NativeFloats a, NativeFloats b) {
    return _mm512_maskz_min_ps(0xFFFF, a, b);
}
inline NativeFloats nativeGreatest(NativeFloats a, NativeFloats b) {
    return _mm512_maskz_max_ps(0xFFFF, a, b);
}
inline unsigned nativeSigns(NativeInts a) {
    return _mm512_movepi32_mask(reinterpret_cast<__m512i>(a));
}
inline NativeInts nativeGather(const std::uint32_t* from, NativeInts index) {
    return reinterpret_cast<NativeInts>(
        _mm512_mask_i32gather_epi32(__m512i{}, 0xFFFF, reinterpret_cast<__m512i>(index), from, 4));
}
inline NativeInts nativeLoad(const std::uint32_t* from) {
    return reinterpret_cast<NativeInts>(_mm512_loadu_si512(from));
}
/// |a - b| - tolerance of each byte, or 0.
inline NativeInts nativeBeyond(NativeInts a, NativeInts b, char tolerance) {
    const auto x = reinterpret_cast<__m512i>(a);
    const auto y = reinterpret_cast<__m512i>(b);
    const __m512i apart = _mm512_or_si512(_mm512_subs_epu8(x, y), _mm512_subs_epu8(y, x));
    return reinterpret_cast<NativeInts>(_mm512_subs_epu8(apart, _mm512_set1_epi8(tolerance)));
}

#elif defined(__AVX2__)

constexpr int native_lanes = 8;
typedef float NativeFloats __attribute__((vector_size(32)));
typedef std::int32_t NativeInts __attribute__((vector_size(32)));

inline NativeFloats nativeRoot(NativeFloats a) {
    return _mm256_sqrt_ps(a);
}
inline NativeFloats nativeLeast(NativeFloats a, NativeFloats b) {
    return _mm256_min_ps(a, b);
}
inline NativeFloats nativeGreatest(NativeFloats a, NativeFloats b) {
    return _mm256_max_ps(a, b);
}
inline unsigned nativeSigns(NativeInts a) {
    return static_cast<unsigned>(_mm256_movemask_ps(reinterpret_cast<__m256>(a)));
}
inline NativeInts nativeGather(const std::uint32_t* from, NativeInts index) {
    return reinterpret_cast<NativeInts>(_mm256_i32gather_epi32(
        reinterpret_cast<const int*>(from), reinterpret_cast<__m256i>(index), 4));
}
inline NativeInts nativeLoad(const std::uint32_t* from) {
    return reinterpret_cast<NativeInts>(_mm256_loadu_si256(reinterpret_cast<const __m256i*>(from)));
}
inline NativeInts nativeBeyond(NativeInts a, NativeInts b, char tolerance) {
    const auto x = reinterpret_cast<__m256i>(a);
    const auto y = reinterpret_cast<__m256i>(b);
    const __m256i apart = _mm256_or_si256(_mm256_subs_epu8(x, y), _mm256_subs_epu8(y, x));
    return reinterpret_cast<NativeInts>(_mm256_subs_epu8(apart, _mm256_set1_epi8(tolerance)));
}

#else

constexpr int native_lanes = 4;
typedef float NativeFloats __attribute__((vector_size(16)));
typedef std::int32_t NativeInts __attribute__((vector_size(16)));

inline NativeFloats nativeRoot(NativeFloats a) {
    return _mm_sqrt_ps(a);
}
inline NativeFloats nativeLeast(NativeFloats a, NativeFloats b) {
    return _mm_min_ps(a, b);
}
inline NativeFloats nativeGreatest(NativeFloats a, NativeFloats b) {
    return _mm_max_ps(a, b);
}
inline unsigned nativeSigns(NativeInts a) {
    return static_cast<unsigned>(_mm_movemask_ps(reinterpret_cast<__m128>(a)));
}
inline NativeInts nativeGather(const std::uint32_t* from, NativeInts index) {
    const auto at = [&](int i) { return static_cast<std::int32_t>(from[index[i]]); };
    return NativeInts{at(0), at(1), at(2), at(3)};
}
inline NativeInts nativeLoad(const std::uint32_t* from) {
    return reinterpret_cast<NativeInts>(_mm_loadu_si128(reinterpret_cast<const __m128i*>(from)));
}
inline NativeInts nativeBeyond(NativeInts a, NativeInts b, char tolerance) {
    const auto x = reinterpret_cast<__m128i>(a);
    const auto y = reinterpret_cast<__m128i>(b);
    const __m128i apart = _mm_or_si128(_mm_subs_epu8(x, y), _mm_subs_epu8(y, x));
    return reinterpret_cast<NativeInts>(_mm_subs_epu8(apart, _mm_set1_epi8(tolerance)));
}

#endif

} // namespace
} // namespace quarn
