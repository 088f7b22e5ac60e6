// STL files.
#include "import/stl/StlReader.h"
#include "tests/fuzz/ModelPromises.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    promises::keep(quarn::readStl, "/nowhere/model.stl", bytes, size);
    return 0;
}
