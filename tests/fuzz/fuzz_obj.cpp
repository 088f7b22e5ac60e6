// OBJ files.
#include "import/obj/ObjReader.h"
#include "tests/fuzz/ModelPromises.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    promises::keep(quarn::readObj, "/nowhere/model.obj", bytes, size);
    return 0;
}
