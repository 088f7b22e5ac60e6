#pragma once

#include "engine/render/kernel/RenderSetup.h"

#include <cstdint>
#include <vector>

namespace quarn {

/// How far the samples of a pixel are numbered at most.
inline constexpr int max_log2_samples = 14;

/// A well-spread sequence of places in the unit square: any aligned run of 2^k of them has one in
/// every box of area 2^-k whose sides are powers of two (I. M. Sobol, "On the Distribution of
/// Points in a Cube and the Approximate Evaluation of Integrals", USSR Computational Mathematics
/// and Mathematical Physics 7(4), 1967; the first two dimensions as in T. Kollig and A. Keller,
/// "Efficient Multidimensional Sampling", Computer Graphics Forum 21(3), 2002).
class SampleSequence {
public:
    /// @param samples  how many are needed, 1 to 2^max_log2_samples
    explicit SampleSequence(int samples);

    /// Valid as long as the sequence lives.
    SampleTable table() const { return {m_first.data(), m_second.data(), m_log2_length}; }

private:
    int m_log2_length = 1;
    std::vector<std::uint32_t> m_first;
    std::vector<std::uint32_t> m_second;
};

/// Coordinates of a place of the sequence as fractions of 32 bits.
std::uint32_t firstCoordinate(std::uint32_t number);
std::uint32_t secondCoordinate(std::uint32_t number);

} // namespace quarn
