#include "import/cad/CadReader.h"

#include "ground/ModuleFile.h"
#include "import/cad/CadModule.h"

#include <string>

namespace quarn {

namespace {

constexpr ModuleFile MODULE = {"QuarnCad.so", READ_CAD_NAME, "libocct-data-exchange-dev",
                               "libocct-data-exchange-7.6"};

Result<SourceScene> read(const ModelReading& reading, CadFormat format) {
    static const Result<void*> module = openModule(MODULE);
    if (!module)
        return Error{"Cannot read '" + reading.path.string() + "': " + module.message() + "."};
    Result<SourceScene> scene = SourceScene{};
    reinterpret_cast<ReadCad>(module.value())(reading, format, scene);
    return scene;
}

} // namespace

Result<SourceScene> readStep(const ModelReading& reading) {
    return read(reading, CadFormat::step);
}

Result<SourceScene> readIges(const ModelReading& reading) {
    return read(reading, CadFormat::iges);
}

Result<SourceScene> readBrep(const ModelReading& reading) {
    return read(reading, CadFormat::brep);
}

} // namespace quarn
