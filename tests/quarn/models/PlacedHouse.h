#pragma once

#include "tests/quarn/Studio.h"

#include <array>
#include <string>

namespace quarn::test {

/// Writes the studio's house, which is 4 long, elsewhere or in another size: each coordinate is
/// multiplied by `scale`, and `offset` is added to it.
/// @param name  of the new model file in the studio
void writePlacedHouse(const Studio& studio, const std::string& name, double scale,
                      const std::array<double, 3>& offset);

} // namespace quarn::test
