#pragma once

#include "engine/scene/EnvironmentPicture.h"

#include <memory>
#include <vector>

namespace quarn {

/// A picture of what lies around, made ready for looking up directions, see EnvironmentMap.h. It is
/// made once for a picture and shared by all frames.
///
/// Where a picture holds a sun, that is one small spot that is brighter than all else, the maps
/// show it no brighter than paper in the sun, and its light is a light of its own, with shadows.
class PictureLight {
public:
    /// @param picture  isPicture; light beyond what any lamp sends is taken for MOST_LIGHT
    explicit PictureLight(std::shared_ptr<const EnvironmentPicture> picture);

    static constexpr float MOST_LIGHT = 1e5F;

    const std::shared_ptr<const EnvironmentPicture>& picture() const { return m_picture; }
    /// PictureMap::floats numbers.
    const float* sharp() const { return m_sharp.data(); }
    /// BroadMap::floats numbers.
    const float* broad() const { return m_broad.data(); }

    bool hasSun() const { return m_has_sun; }
    const float* towardSun() const { return m_toward_sun; } ///< of unit length
    const float* sunColor() const { return m_sun_color; }   ///< on a white surface that faces it
    /// The brightness of a white surface, beside the sun's light: the mean over all directions.
    float meanLight() const { return m_mean; }

private:
    void findSun();
    void findMean();

    std::shared_ptr<const EnvironmentPicture> m_picture;
    std::vector<float> m_sharp;
    std::vector<float> m_broad;
    float m_mean = 0.0F;
    bool m_has_sun = false;
    float m_toward_sun[3] = {0.0F, 0.0F, 1.0F};
    float m_sun_color[3] = {0.0F, 0.0F, 0.0F};
};

} // namespace quarn
