#include "host/cocoa/NibFile.h"

#include <dlfcn.h>
#include <filesystem>
#include <string>

#ifdef GNUSTEP
#include <objc/runtime.h>
#else
#include <objc/objc-runtime.h>
#endif

namespace quarn {
namespace {

namespace fs = std::filesystem;

/// The library that holds the code of a class; empty when the system does not know it.
fs::path libraryOf(Class owner) {
    Dl_info library{};
    const IMP code = class_getMethodImplementation(owner, @selector(nibName));
    if (!dladdr(reinterpret_cast<const void*>(code), &library) || !library.dli_fname) {
        return {};
    }
    std::error_code error;
    const fs::path whole = fs::canonical(library.dli_fname, error);
    return error ? fs::path() : whole;
}

/// A nib is compiled on macOS and read as the text it is made of elsewhere.
constexpr const char* ENDINGS[] = {".nib", ".xib"};

} // namespace

NSString* nibFile(NSString* name, Class owner) {
    NSString* const resource = [[NSBundle bundleForClass:owner] pathForResource:name ofType:@"nib"];
    if (resource) {
        return resource;
    }
    const fs::path folder = libraryOf(owner).parent_path().parent_path() / "share/quarn/cocoa";
    for (const char* ending : ENDINGS) {
        const fs::path file = folder / (std::string([name UTF8String]) + ending);
        std::error_code error;
        if (fs::is_regular_file(file, error)) {
            return [NSString stringWithUTF8String:file.c_str()];
        }
    }
    return nil;
}

} // namespace quarn
