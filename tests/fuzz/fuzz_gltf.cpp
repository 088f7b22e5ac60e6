// glTF files, text and binary.
#include "import/gltf/GltfReader.h"
#include "tests/fuzz/ModelPromises.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    promises::keep(quarn::readGltf, "/nowhere/model.gltf", bytes, size);
    return 0;
}
