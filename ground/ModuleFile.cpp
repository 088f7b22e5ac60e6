#include "ground/ModuleFile.h"

#include <dlfcn.h>
#include <string>

namespace quarn {

std::filesystem::path installedTree() {
    Dl_info here{};
    std::error_code failure;
    if (dladdr(reinterpret_cast<const void*>(&installedTree), &here) == 0 ||
        here.dli_fname == nullptr)
        return {};
    return std::filesystem::canonical(here.dli_fname, failure).parent_path().parent_path();
}

Result<void*> openModule(const ModuleFile& module) {
    const std::filesystem::path file = installedTree() / "lib" / "quarn" / module.name;
    std::error_code failure;
    if (!std::filesystem::exists(file, failure))
        return Error{std::string("this build of the program has no module for it. Install ") +
                     module.build_packages + " and build the program again"};
    void* const opened = dlopen(file.c_str(), RTLD_NOW | RTLD_LOCAL);
    if (opened == nullptr)
        return Error{std::string("the module for it cannot be opened (") + dlerror() +
                     "). Install " + module.runtime_package};
    if (void* const function = dlsym(opened, module.function))
        return function;
    return Error{"the module " + file.string() + " is of another build. Build it again"};
}

} // namespace quarn
