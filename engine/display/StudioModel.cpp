#include "engine/display/StudioModel.h"

#include <cmath>
#include <numbers>

namespace quarn {

namespace {

/// @param azimuth_deg   degrees clockwise from +y, seen from above
/// @param altitude_deg  degrees above the floor
SoftBox boxAt(float azimuth_deg, float altitude_deg, float half_width_deg, float half_height_deg,
              float light) {
    constexpr float degree = std::numbers::pi_v<float> / 180.0F;
    SoftBox box;
    box.toward[0] = std::sin(azimuth_deg * degree) * std::cos(altitude_deg * degree);
    box.toward[1] = std::cos(azimuth_deg * degree) * std::cos(altitude_deg * degree);
    box.toward[2] = std::sin(altitude_deg * degree);
    box.half_width_deg = half_width_deg;
    box.half_height_deg = half_height_deg;
    box.border = 0.12F;
    box.color = {light, light, light};
    return box;
}

} // namespace

Lighting productStudio() {
    Lighting lighting;
    lighting.sky.horizon = {0.34F, 0.34F, 0.34F};
    lighting.sky.zenith = {0.16F, 0.16F, 0.16F};
    lighting.sky.nadir = {0.16F, 0.16F, 0.16F};
    lighting.boxes = {
        boxAt(0.0F, 90.0F, 30.0F, 30.0F, 1.7F), boxAt(-125.0F, 38.0F, 21.0F, 21.0F, 4.0F),
        boxAt(115.0F, 22.0F, 10.0F, 30.0F, 1.3F), boxAt(15.0F, 28.0F, 30.0F, 12.0F, 1.0F)};
    return lighting;
}

} // namespace quarn
