// PLY files.
#include "import/ply/PlyReader.h"
#include "tests/fuzz/ModelPromises.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    promises::keep(quarn::readPly, "/nowhere/model.ply", bytes, size);
    return 0;
}
