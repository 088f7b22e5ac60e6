#pragma once

#include "engine/scene/Material.h"

#include <functional>
#include <string>
#include <vector>

namespace quarn::test {

/// A quality of a material, written down by hand, changed to a value that no other has.
struct QualityChange {
    std::string name;
    std::function<void(Material&)> make;
    std::function<bool(const Material&)> is_made;
};

/// One for each quality beyond the base colour.
std::vector<QualityChange> qualityChanges();

/// A texture of 2 x 1 pixels.
std::shared_ptr<const Texture> pairOfPixels(std::uint8_t first);

/// A material in which every quality is changed.
Material changedMaterial();

} // namespace quarn::test
