#include "host/reader/ReaderProgram.h"

#include "ground/PathText.h"
#include "sdk/qncore/QnLocalize.h"

#include <cstdlib>
#include <dlfcn.h>
#include <string_view>
#include <system_error>
#include <unistd.h>

namespace quarn {

namespace {

namespace fs = std::filesystem;

constexpr const char* NAME = "quarn-reader";
constexpr std::string_view INSIDE = "inside";

std::string_view choice() {
    const char* const value = std::getenv(READER_VARIABLE);
    return value ? value : "";
}

/// The folder of the library, or of the program, that this function is in.
fs::path ownFolder() {
    Dl_info place{};
    std::error_code none;
    if (dladdr(reinterpret_cast<const void*>(&readsInside), &place) == 0 || !place.dli_fname)
        return {};
    const fs::path found = fs::canonical(place.dli_fname, none);
    // A program may be known by the name that it was called by.
    return (none ? fs::read_symlink("/proc/self/exe", none) : found).parent_path();
}

bool canRun(const fs::path& program) {
    std::error_code none;
    return fs::is_regular_file(program, none) && access(program.c_str(), X_OK) == 0;
}

} // namespace

bool readsInside() {
    return choice() == INSIDE;
}

Result<fs::path> readerProgram() {
    const fs::path folder = ownFolder();
    fs::path first = choice().empty() ? folder.parent_path() / "bin" / NAME : fs::path(choice());
    if (canRun(first))
        return first;
    if (choice().empty() && canRun(folder / NAME))
        return folder / NAME;
    return Error{KM_wString::FormatToString(
                     QnLocalizeString(L"The program that reads model files is missing: there is no "
                                      L"%s. Install Quarn with all its files.",
                                      42600),
                     textFromPath(first).Array())
                     .ToUtf8()};
}

} // namespace quarn
