// What a reading process hands over. What is taken is a model that can be handed over again, and is
// then the same.
#include "import/transfer/ModelTransfer.h"

#include <cstdint>
#include <cstdlib>
#include <span>
#include <vector>

namespace {

using namespace quarn;
using Bytes = std::vector<std::uint8_t>;

// A broken promise ends the program, which is how a fuzzer learns of it.
void require(bool promise) {
    if (!promise)
        std::abort();
}

SharedBlock emptyBlock() {
    Result<SharedBlock> block = SharedBlock::make();
    require(block.ok());
    return std::move(block.value());
}

Result<ImportedModel> taken(std::span<const std::uint8_t> bytes) {
    SharedBlock block = emptyBlock();
    require(block.append(bytes).ok());
    return takeModel(block);
}

Bytes written(const ImportedModel& model) {
    SharedBlock block = emptyBlock();
    require(writeModel(model, block).ok());
    Bytes bytes(block.size());
    require(block.read(0, bytes));
    return bytes;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    const Result<ImportedModel> model = taken({bytes, size});
    if (!model) {
        require(!model.message().empty());
        return 0;
    }
    for (const ImportedMesh& mesh : model.value().meshes)
        require(mesh.placed.mesh->IsValid());
    const Bytes once = written(model.value());
    const Result<ImportedModel> again = taken(once);
    require(again.ok() && written(again.value()) == once);
    return 0;
}
