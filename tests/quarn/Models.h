#pragma once

#include "tests/support/TempFolder.h"

namespace quarn::test {

/// A box of 4 x 2 x 1 with a tall box on one corner: it looks different from every side.
/// 16 vertices, 24 triangles.
void writeHouse(const std::filesystem::path& obj_file);

} // namespace quarn::test
