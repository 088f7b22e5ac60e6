#pragma once

#include "examples/pavilion/ModelWriter.h"

#include <algorithm>
#include <functional>
#include <numbers>

/// A box between two opposite corners, with its edges cut off by `chamfer`.
inline void addBox(ModelWriter& model, const Vec& low, const Vec& high, double chamfer = 0.0) {
    const auto at = [&](int i, int j, int k, const Vec& inset) {
        return Vec{i ? high.x - inset.x : low.x + inset.x, j ? high.y - inset.y : low.y + inset.y,
                   k ? high.z - inset.z : low.z + inset.z};
    };
    const double c = chamfer;
    // The four corners of each side, anticlockwise from outside.
    static constexpr int sides[6][4][3] = {
        {{0, 0, 0}, {0, 0, 1}, {0, 1, 1}, {0, 1, 0}}, {{1, 0, 0}, {1, 1, 0}, {1, 1, 1}, {1, 0, 1}},
        {{0, 0, 0}, {1, 0, 0}, {1, 0, 1}, {0, 0, 1}}, {{0, 1, 0}, {0, 1, 1}, {1, 1, 1}, {1, 1, 0}},
        {{0, 0, 0}, {0, 1, 0}, {1, 1, 0}, {1, 0, 0}}, {{0, 0, 1}, {1, 0, 1}, {1, 1, 1}, {0, 1, 1}}};
    const Vec insets[3] = {{0, c, c}, {c, 0, c}, {c, c, 0}}; // of sides across x, y and z
    for (int s = 0; s < 6; ++s) {
        std::vector<Vec> corners;
        for (const auto& corner : sides[s]) {
            corners.push_back(at(corner[0], corner[1], corner[2], insets[s / 2]));
        }
        model.face(corners);
    }
    if (chamfer <= 0.0) {
        return;
    }
    for (int i = 0; i < 2; ++i) {
        for (int j = 0; j < 2; ++j) {
            const bool flip = i != j;
            const auto band = [&](Vec a, Vec b, Vec d, Vec e) {
                flip ? model.face({a, b, d, e}) : model.face({e, d, b, a});
            };
            band(at(i, j, 0, insets[0]), at(i, j, 1, insets[0]), at(i, j, 1, insets[1]),
                 at(i, j, 0, insets[1]));
            band(at(0, i, j, insets[1]), at(1, i, j, insets[1]), at(1, i, j, insets[2]),
                 at(0, i, j, insets[2]));
            band(at(j, 0, i, insets[2]), at(j, 1, i, insets[2]), at(j, 1, i, insets[0]),
                 at(j, 0, i, insets[0]));
            for (int k = 0; k < 2; ++k) {
                const Vec a = at(i, j, k, insets[0]);
                const Vec b = at(i, j, k, insets[1]);
                const Vec d = at(i, j, k, insets[2]);
                (i + j + k) % 2 ? model.face({a, b, d}) : model.face({d, b, a});
            }
        }
    }
}

/// One point of a profile that is turned about an upright axis.
struct ProfilePoint {
    double radius;
    double height;
    bool crease = false; ///< the surface has an edge here
};

/// The directions that a profile's surface faces just before and just after a point, as (out, up).
inline std::pair<double, double> profileNormal(const ProfilePoint& a, const ProfilePoint& b) {
    const double out = b.height - a.height;
    const double up = a.radius - b.radius;
    const double l = std::hypot(out, up);
    return l > 0.0 ? std::pair(out / l, up / l) : std::pair(1.0, 0.0);
}

/// The surface that a profile sweeps when it turns about the axis through `foot`. The profile runs
/// so that the outside is to its right: upward for the outside of a column.
inline void addTurned(ModelWriter& model, const Vec& foot, std::span<const ProfilePoint> profile,
                      int segments, double phase = 0.0) {
    const auto normalAt = [&](std::size_t point, std::size_t piece) {
        const auto own = profileNormal(profile[piece], profile[piece + 1]);
        const bool first = point == piece;
        const bool has_other = first ? point > 0 : point + 2 <= profile.size() - 1;
        if (profile[point].crease || !has_other) {
            return own;
        }
        const std::size_t other = first ? piece - 1 : piece + 1;
        const auto next = profileNormal(profile[other], profile[other + 1]);
        return std::pair(own.first + next.first, own.second + next.second);
    };
    for (std::size_t piece = 0; piece + 1 < profile.size(); ++piece) {
        for (int s = 0; s < segments; ++s) {
            const auto corner = [&](std::size_t point, int step) {
                const double angle = phase + 2.0 * std::numbers::pi * step / segments;
                const auto [out, up] = normalAt(point, piece);
                const double c = std::cos(angle);
                const double d = std::sin(angle);
                const ProfilePoint& p = profile[point];
                return Corner{foot + Vec{p.radius * c, p.radius * d, p.height},
                              {out * c, out * d, up}};
            };
            std::vector<Corner> corners{corner(piece, s)};
            if (profile[piece].radius > 0.0) {
                corners.push_back(corner(piece, s + 1));
            }
            if (profile[piece + 1].radius > 0.0) {
                corners.push_back(corner(piece + 1, s + 1));
            }
            corners.push_back(corner(piece + 1, s));
            model.face(std::span<const Corner>(corners));
        }
    }
}

/// Profile points on an arc about (radius, height) from one angle to another; degrees, 0 outward,
/// 90 up.
inline void appendArc(std::vector<ProfilePoint>& profile, double radius, double height, double size,
                      double from_deg, double to_deg, int steps) {
    for (int i = 0; i <= steps; ++i) {
        const double a = (from_deg + (to_deg - from_deg) * i / steps) * std::numbers::pi / 180.0;
        const bool end = i == 0 || i == steps;
        profile.push_back(
            {std::max(0.0, radius + size * std::cos(a)), height + size * std::sin(a), end});
    }
}

/// A number from 0 to 1 that looks random but is the same on every machine.
inline double scattered(unsigned seed) {
    unsigned h = seed * 2654435761U;
    h ^= h >> 15;
    h *= 2246822519U;
    h ^= h >> 13;
    h *= 3266489917U;
    h ^= h >> 16;
    return static_cast<double>(h) / 4294967295.0;
}

/// A ball whose surface swells and sinks a little, like the crown of a tree.
inline void addBlob(ModelWriter& model, const Vec& centre, const Vec& radii, unsigned seed,
                    double roughness = 0.10) {
    constexpr int around = 32;
    constexpr int rings = 18;
    const double shift = 6.0 * scattered(seed);
    const auto place = [&](double turn, double rise) {
        const double a = 2.0 * std::numbers::pi * turn;
        const double b = std::numbers::pi * (rise - 0.5);
        const double swell =
            1.0 + roughness * std::cos(b) *
                      (std::sin(5.0 * a + shift + 3.0 * b) +
                       0.7 * std::sin(3.0 * a - 2.0 * shift - 7.0 * b) +
                       0.6 * std::sin(9.0 * a + 2.0 * shift) * std::sin(8.0 * b + shift));
        return centre + Vec{radii.x * swell * std::cos(b) * std::cos(a),
                            radii.y * swell * std::cos(b) * std::sin(a),
                            radii.z * swell * std::sin(b)};
    };
    const auto corner = [&](int s, int r) {
        const double turn = static_cast<double>(s % around) / around;
        const double rise = static_cast<double>(r) / rings;
        const double h = 1e-4;
        if (r == 0 || r == rings) {
            return Corner{place(0.0, rise), {0.0, 0.0, r == 0 ? -1.0 : 1.0}};
        }
        return Corner{place(turn, rise), cross(place(turn + h, rise) - place(turn - h, rise),
                                               place(turn, rise + h) - place(turn, rise - h))};
    };
    for (int r = 0; r < rings; ++r) {
        for (int s = 0; s < around; ++s) {
            std::vector<Corner> corners{corner(s, r)};
            if (r > 0) {
                corners.push_back(corner(s + 1, r));
            }
            if (r + 1 < rings) {
                corners.push_back(corner(s + 1, r + 1));
            }
            corners.push_back(corner(s, r + 1));
            model.face(std::span<const Corner>(corners));
        }
    }
}

/// A round bar between two places.
inline void addBar(ModelWriter& model, const Vec& from, const Vec& to, double radius,
                   int segments = 10) {
    const Vec axis = unit(to - from);
    const Vec side = unit(cross(axis, std::abs(axis.z) < 0.9 ? Vec{0, 0, 1} : Vec{1, 0, 0}));
    const Vec up = cross(axis, side);
    std::vector<Vec> start;
    std::vector<Vec> end;
    for (int s = 0; s < segments; ++s) {
        const double a = 2.0 * std::numbers::pi * s / segments;
        const double b = 2.0 * std::numbers::pi * ((s + 1) % segments) / segments;
        const Vec na = side * std::cos(a) + up * std::sin(a);
        const Vec nb = side * std::cos(b) + up * std::sin(b);
        const Corner corners[4] = {{from + na * radius, na},
                                   {from + nb * radius, nb},
                                   {to + nb * radius, nb},
                                   {to + na * radius, na}};
        model.face(std::span<const Corner>(corners));
        start.insert(start.begin(), from + na * radius);
        end.push_back(to + na * radius);
    }
    model.face(start);
    model.face(end);
}
