#pragma once

#include <array>

namespace quarn {

/// How much of the light that comes evenly from everywhere a surface of many small mirrors sends to
/// the observer, where no light passes from mirror to mirror: f0 a + f90 b, for what it mirrors
/// seen straight on and along its face (B. Karis, "Real Shading in Unreal Engine 4", 2013). The
/// mirrors lie as B. Walter, S. Marschner, H. Li and K. Torrance say in "Microfacet Models for
/// Refraction through Rough Surfaces", EGSR 2007, and hide each other as in E. Heitz,
/// "Understanding the Masking-Shadowing Function in Microfacet-Based BRDFs", JCGT 2014 (99).
class SplitSum {
public:
    /// Entries by roughness, and in each row by the cosine between normal and observer; both from 0
    /// to 1.
    static constexpr int side = 32;

    SplitSum();
    /// All a, row by row, then all b.
    const float* entries() const { return m_entries.data(); }

private:
    std::array<float, std::size_t{2} * side * side> m_entries;
};

/// The table, made once.
const SplitSum& splitSum();

} // namespace quarn
