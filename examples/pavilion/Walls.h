#pragma once

#include "examples/pavilion/Shapes.h"

/// A rectangle on a wall: from the left, seen from outside, and from the wall's foot.
struct Opening {
    double left;
    double right;
    double bottom;
    double top;
};

/// An upright plane. `along` points to the right as seen from outside, so outside is where
/// `along` x up points.
struct WallFrame {
    Vec origin; ///< the lower left corner, seen from outside
    Vec along;  ///< unit vector

    Vec outward() const { return cross(along, {0.0, 0.0, 1.0}); }
    Vec at(double right, double up, double depth = 0.0) const {
        return origin + along * right + Vec{0.0, 0.0, up} - outward() * depth;
    }
};

inline bool isInside(const Opening& o, double right, double up) {
    return right > o.left && right < o.right && up > o.bottom && up < o.top;
}

/// The outer face of a wall with openings, and the openings' reveals of the given depth.
inline void addFacade(ModelWriter& model, const WallFrame& wall, double width, double height,
                      std::span<const Opening> openings, double reveal) {
    std::vector<double> rights{0.0, width};
    std::vector<double> ups{0.0, height};
    for (const Opening& o : openings) {
        rights.insert(rights.end(), {o.left, o.right});
        ups.insert(ups.end(), {o.bottom, o.top});
    }
    for (std::vector<double>* cuts : {&rights, &ups}) {
        std::sort(cuts->begin(), cuts->end());
        cuts->erase(std::unique(cuts->begin(), cuts->end()), cuts->end());
    }
    for (std::size_t i = 0; i + 1 < rights.size(); ++i) {
        for (std::size_t j = 0; j + 1 < ups.size(); ++j) {
            const double x = 0.5 * (rights[i] + rights[i + 1]);
            const double z = 0.5 * (ups[j] + ups[j + 1]);
            if (std::none_of(openings.begin(), openings.end(),
                             [&](const Opening& o) { return isInside(o, x, z); })) {
                model.face({wall.at(rights[i], ups[j]), wall.at(rights[i + 1], ups[j]),
                            wall.at(rights[i + 1], ups[j + 1]), wall.at(rights[i], ups[j + 1])});
            }
        }
    }
    if (reveal <= 0.0) {
        return;
    }
    for (const Opening& o : openings) {
        const auto p = [&](double right, double up, bool deep) {
            return wall.at(right, up, deep ? reveal : 0.0);
        };
        model.face({p(o.left, o.bottom, true), p(o.left, o.top, true), p(o.left, o.top, false),
                    p(o.left, o.bottom, false)});
        model.face({p(o.right, o.bottom, false), p(o.right, o.top, false), p(o.right, o.top, true),
                    p(o.right, o.bottom, true)});
        model.face({p(o.left, o.top, false), p(o.left, o.top, true), p(o.right, o.top, true),
                    p(o.right, o.top, false)});
        model.face({p(o.left, o.bottom, true), p(o.left, o.bottom, false),
                    p(o.right, o.bottom, false), p(o.right, o.bottom, true)});
    }
}

/// A block that stands on or in a wall: between two depths, negative ones before the wall.
inline void addWallBlock(ModelWriter& model, const WallFrame& wall, const Opening& o,
                         double front_depth, double back_depth) {
    const auto p = [&](double right, double up, bool deep) {
        return wall.at(right, up, deep ? back_depth : front_depth);
    };
    model.face({p(o.left, o.bottom, false), p(o.right, o.bottom, false), p(o.right, o.top, false),
                p(o.left, o.top, false)});
    model.face({p(o.right, o.bottom, true), p(o.left, o.bottom, true), p(o.left, o.top, true),
                p(o.right, o.top, true)});
    model.face({p(o.left, o.bottom, true), p(o.left, o.bottom, false), p(o.left, o.top, false),
                p(o.left, o.top, true)});
    model.face({p(o.right, o.bottom, false), p(o.right, o.bottom, true), p(o.right, o.top, true),
                p(o.right, o.top, false)});
    model.face({p(o.left, o.top, false), p(o.right, o.top, false), p(o.right, o.top, true),
                p(o.left, o.top, true)});
    model.face({p(o.left, o.bottom, true), p(o.right, o.bottom, true), p(o.right, o.bottom, false),
                p(o.left, o.bottom, false)});
}

/// The bars of a window: a frame and a cross, at a depth behind the wall's face.
inline void addWindowBars(ModelWriter& model, const WallFrame& wall, const Opening& o,
                          double depth) {
    constexpr double w = 0.06;
    const double middle = 0.5 * (o.left + o.right);
    const double rail = o.bottom + 0.62 * (o.top - o.bottom);
    const Opening bars[] = {{o.left, o.left + w, o.bottom, o.top},
                            {o.right - w, o.right, o.bottom, o.top},
                            {middle - w / 2, middle + w / 2, o.bottom, o.top},
                            {o.left + w, o.right - w, o.bottom, o.bottom + w},
                            {o.left + w, o.right - w, o.top - w, o.top},
                            {o.left + w, o.right - w, rail - w / 2, rail + w / 2}};
    for (const Opening& bar : bars) {
        addWallBlock(model, wall, bar, depth - 0.04, depth + 0.02);
    }
}
