#pragma once

#include <xmmintrin.h>

namespace quarn {

/// While it lives, numbers too small for a normal float count as zero on this thread, as the ray
/// tracer wants it; then the thread's own mode is back.
class FlushDenormals {
public:
    FlushDenormals() : m_before(_mm_getcsr()) {
        _mm_setcsr(m_before | flush_to_zero_and_from_zero);
    }
    ~FlushDenormals() { _mm_setcsr(m_before); }
    FlushDenormals(const FlushDenormals&) = delete;
    FlushDenormals& operator=(const FlushDenormals&) = delete;

private:
    static constexpr unsigned flush_to_zero_and_from_zero = 0x8040;
    unsigned m_before;
};

} // namespace quarn
