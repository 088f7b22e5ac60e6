// OBJ files, and the same bytes as a material file.
#include "import/obj/MaterialFile.h"
#include "import/obj/ObjReader.h"
#include "import/text/LineCursor.h"
#include "tests/fuzz/ModelPromises.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    promises::keep(quarn::readObj, "/nowhere/model.obj", bytes, size);
    for (const quarn::FileMaterial& material :
         quarn::readMaterialFile(quarn::textOf({bytes, size})).materials)
        promises::require(!material.opacity || (*material.opacity >= 0 && *material.opacity <= 1));
    return 0;
}
