#pragma once

namespace quarn {

/// A direction about (0, 0, 1).
struct MirrorNormal {
    float x;
    float y;
    float z;
};

/// The normal of the i-th of `count` small mirrors that make up a rough surface, each standing for
/// an equal part of it: the points of J. M. Hammersley, "Monte Carlo Methods for Solving
/// Multivariable Problems", Annals of the New York Academy of Sciences, 1960, spread by equation 35
/// of B. Walter, S. Marschner, H. Li and K. Torrance, "Microfacet Models for Refraction through
/// Rough Surfaces", EGSR 2007.
/// @param alpha  the surface's roughness, squared
MirrorNormal smallMirror(int i, int count, float alpha);

} // namespace quarn
