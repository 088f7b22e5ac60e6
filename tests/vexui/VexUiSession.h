#pragma once

#include "host/front_end/ScriptedFrontEnd.h"
#include "host/session/Session.h"
#include "tests/support/TempFolder.h"

#include <filesystem>
#include <string>

/// Where a session finds the plug-ins of the build tree and their texts.
inline quarn::SessionOptions vexUiOptions(const std::filesystem::path& documents,
                                          const std::string& language) {
    quarn::SessionOptions options;
    options.plug_in_folders.push_back(std::filesystem::path(VEXUI_PLUGIN_PATH).parent_path());
    options.locale_folders.push_back(std::filesystem::path(QUARN_SHARE_DIR) / "locale/host");
    options.language = language;
    options.documents_folder = documents;
    return options;
}
