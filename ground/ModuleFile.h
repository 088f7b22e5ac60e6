#pragma once

#include "ground/Result.h"

#include <filesystem>

namespace quarn {

/// The folder of the program with all its files, installed or only built: the one that holds the
/// folder of the library or program that this code is a part of. Empty where the system does not
/// tell.
std::filesystem::path installedTree();

/// A module of the program: a library that is opened only when it is needed, because what it stands
/// on is large, or is not on every machine.
struct ModuleFile {
    const char* name;            ///< of its file, "QuarnCad.so"
    const char* function;        ///< what it exports
    const char* build_packages;  ///< of Debian, that building it takes
    const char* runtime_package; ///< of Debian, that running it takes
};

/// Opens a module, which stays open: large libraries do not bear being closed.
/// @return the function that it exports; an error, the part of a sentence behind a colon, that
/// names
///         the package to install
Result<void*> openModule(const ModuleFile& module);

} // namespace quarn
