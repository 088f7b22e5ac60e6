#pragma once

#include "host/session/Session.h"

namespace quarn::desktop {

/// Where plug-in files are: build tree and installed tree look the same from the program's folder.
std::filesystem::path plugInFolder();

/// What a session of this program is started with: plug-ins and texts that are installed beside it.
/// @param language  as SessionOptions::language
SessionOptions sessionOptions(const std::string& language);

} // namespace quarn::desktop
