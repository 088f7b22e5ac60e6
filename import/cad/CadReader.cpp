#include "import/cad/CadReader.h"

#include "import/cad/CadModule.h"

#include <dlfcn.h>
#include <string>

namespace quarn {

namespace {

namespace fs = std::filesystem;

/// The module's place in an installed tree and in one that was only built, from the library or the
/// program that this code is a part of.
fs::path moduleFile() {
    constexpr const char* NAME = "quarn/QuarnCad.so";
    Dl_info here{};
    std::error_code failure;
    if (dladdr(reinterpret_cast<const void*>(&moduleFile), &here) == 0 || here.dli_fname == nullptr)
        return {};
    const fs::path folder = fs::canonical(here.dli_fname, failure).parent_path();
    const fs::path in_library_folder = folder / NAME;
    return fs::exists(in_library_folder, failure) ? in_library_folder
                                                  : folder.parent_path() / "lib" / NAME;
}

struct CadModule {
    ReadCad read;
};

/// The module stays open: its libraries do not bear being closed.
Result<CadModule> openModule() {
    const fs::path file = moduleFile();
    std::error_code failure;
    if (!fs::exists(file, failure))
        return Error{"this build of the program has no module for it. Install "
                     "libocct-data-exchange-dev and build the program again"};
    void* const module = dlopen(file.c_str(), RTLD_NOW | RTLD_LOCAL);
    if (module == nullptr)
        return Error{std::string("the module that reads it cannot be opened (") + dlerror() +
                     "). Install libocct-data-exchange-7.6"};
    void* const symbol = dlsym(module, READ_CAD_NAME);
    if (symbol == nullptr)
        return Error{"the module " + file.string() + " is of another build. Build it again"};
    return CadModule{reinterpret_cast<ReadCad>(symbol)};
}

Result<SourceScene> read(const ModelReading& reading, CadFormat format) {
    static const Result<CadModule> module = openModule();
    if (!module)
        return Error{"Cannot read '" + reading.path.string() + "': " + module.message() + "."};
    Result<SourceScene> scene = SourceScene{};
    module.value().read(reading, format, scene);
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
