// OFF files.
#include "import/off/OffReader.h"
#include "tests/fuzz/ModelPromises.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    promises::keep(quarn::readOff, "/nowhere/model.off", bytes, size);
    return 0;
}
