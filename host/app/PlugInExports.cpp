#include "host/app/PlugInExports.h"

#include "host/border/Border.h"
#include "sdk/qncore/QnExport.h"

namespace quarn {

namespace {

using Outcome = PlugInLoad::Outcome;
using VersionFunction = unsigned int (*)();

constexpr const char* SDK_VERSION = "QuarnPlugInSdkVersion";
constexpr const char* SDK_SERVICE_RELEASE = "QuarnPlugInSdkServiceRelease";
constexpr const char* ENTRIES[] = {
    SDK_VERSION,
    SDK_SERVICE_RELEASE,
    "QuarnPlugInUpdateURL",
    "QuarnPlugInDeveloperOrganization",
    "QuarnPlugInDeveloperAddress",
    "QuarnPlugInDeveloperCountry",
    "QuarnPlugInDeveloperPhone",
    "QuarnPlugInDeveloperFax",
    "QuarnPlugInDeveloperEmail",
    "QuarnPlugInDeveloperWebsite",
};

std::string missingEntries(const LibraryFile& library) {
    std::string missing;
    for (const char* entry : ENTRIES) {
        if (!library.find(entry))
            missing += (missing.empty() ? "" : ", ") + std::string(entry);
    }
    return missing;
}

PlugInLoad checkVersion(const LibraryFile& library, const char* entry,
                        const std::filesystem::path& file) {
    const auto ask = reinterpret_cast<VersionFunction>(library.find(entry));
    const Result<unsigned int> version = acrossBorder([&] { return ask(); });
    if (!version)
        return {Outcome::version_mismatch, "The plug-in " + file.string() +
                                               " does not tell its version: " + version.message()};
    if (version.value() == QUARN_SDK_VERSION)
        return {};
    return {Outcome::version_mismatch,
            "The plug-in " + file.string() + " was built for interface version " +
                std::to_string(version.value()) + " (" + entry + "), but this host has version " +
                std::to_string(QUARN_SDK_VERSION) + ". Build the plug-in for this host."};
}

} // namespace

PlugInLoad checkExports(const LibraryFile& library, const std::filesystem::path& file) {
    if (const std::string missing = missingEntries(library); !missing.empty())
        return {Outcome::exports_missing, "The file " + file.string() +
                                              " is no plug-in: it does not export " + missing +
                                              "."};
    if (PlugInLoad checked = checkVersion(library, SDK_VERSION, file); !checked.ok())
        return checked;
    return checkVersion(library, SDK_SERVICE_RELEASE, file);
}

PlugInLoad refusedByLinker(const std::string& reason, const std::filesystem::path& file) {
    if (reason.find("version `QNCORE_") != std::string::npos)
        return {Outcome::version_mismatch, "The plug-in " + file.string() +
                                               " was built for another host than version " +
                                               std::to_string(QUARN_SDK_VERSION) + ": " + reason};
    return {Outcome::not_a_library,
            "The file " + file.string() + " cannot be loaded as a library: " + reason};
}

} // namespace quarn
