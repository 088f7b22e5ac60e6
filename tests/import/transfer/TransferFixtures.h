#pragma once

#include "import/ImportedModel.h"
#include "import/transfer/ModelTransfer.h"

#include <cstdint>
#include <span>
#include <vector>

namespace quarn::test {

/// A model that has some of everything that crosses from one process to the other: two objects that
/// share a mesh, two materials that share a texture, a curve, points, a camera, a light.
ImportedModel modelOfEverything();

SharedBlock emptyBlock();
SharedBlock blockOf(std::span<const std::uint8_t> bytes);
/// All bytes of a block.
std::vector<std::uint8_t> bytesOf(const SharedBlock& block);

} // namespace quarn::test
