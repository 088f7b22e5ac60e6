#pragma once

#include "kelmar/KM_Export.h"
#include "kelmar/KM_Point.h"

/// A box along the world axes, in model units.
class KELMAR_API KM_BoundingBox {
public:
    KM_3dPoint m_min{1.0, 0.0, 0.0};
    KM_3dPoint m_max{-1.0, 0.0, 0.0};

    /// The box that holds nothing; it is not valid, and growing it gives what it was grown by.
    static const KM_BoundingBox EmptyBoundingBox;

    /// The empty box.
    constexpr KM_BoundingBox() = default;
    constexpr KM_BoundingBox(const KM_3dPoint& min, const KM_3dPoint& max)
        : m_min(min), m_max(max) {}

    /// True when all coordinates are valid and min <= max in each; a single point is valid.
    bool IsValid() const;
    /// The middle of a valid box; the unset point for one that is not.
    KM_3dPoint Center() const;
    /// From m_min to m_max; zero for a box that is not valid.
    KM_3dVector Diagonal() const;

    /// Makes the box hold the point: grown by it, or with `grow` false set to it alone.
    /// @return false, with the box unchanged, when the point is not valid
    bool Set(const KM_3dPoint& point, bool grow = true);
    /// Grows the box to hold `other`; a box that is not valid adds nothing.
    /// @return whether this box is valid afterwards
    bool Union(const KM_BoundingBox& other);
    /// True when the point lies in the box or on its border.
    bool Includes(const KM_3dPoint& point) const;
    /// Corner 0 to 7 of the box: bit 0 of the index takes the larger x, bit 1 y, bit 2 z.
    KM_3dPoint Corner(int index) const;

    friend bool operator==(const KM_BoundingBox&, const KM_BoundingBox&) = default;
};
