#pragma once

#include "engine/render/kernel/RenderSetup.h"

#include <array>
#include <vector>

namespace quarn {

/// Where rays look for the light from far away: the more often the brighter it is there. A dim part
/// is looked at as if it were a twentieth as bright as all are on average, so that nothing is
/// missed.
class EnvironmentChances {
public:
    /// Goes through what lies around. Nothing is kept where it is so even that rays in directions
    /// that surfaces prefer find it as well: below `least_unevenness` times the mean.
    /// @param frame  without the suns' discs
    void find(const FrameSetup& frame, const RenderKernel& kernel);

    /// Valid as long as the object is and finds nothing else.
    EnvironmentTable table() const;

    static constexpr float least_unevenness = 6.0F;

private:
    static constexpr int side = EnvironmentTable::side;
    struct Brightness {
        std::vector<float> of_cell; ///< times the cell's part of all directions
        float mean = 0.0F;
        float most = 0.0F;
    };

    static Brightness brightnessAround(const FrameSetup& frame, const RenderKernel& kernel);

    std::vector<float> m_rows; ///< empty: nothing is preferred
    std::vector<float> m_cells;
    std::vector<float> m_density;
};

} // namespace quarn
