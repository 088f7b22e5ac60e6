#pragma once

#include "host/almanac/CivilSite.h"
#include "quarn/session/HostSession.h"
#include "quarn/words/Words.h"

#include <filesystem>
#include <optional>
#include <string>

namespace quarn::program {

/// A sun path diagram that is to be written.
struct SunPathRequest {
    CivilSite site;
    bool has_north = false; ///< whether the site's is known
    std::string zone_note;  ///< a sentence without its full stop; empty: nothing
    int year = 0;
    bool is_stereographic = true;
    bool is_orthographic = false;
    std::filesystem::path model; ///< empty: none
    std::optional<Triple> point; ///< in model units; with a model this or an object
    std::string object;          ///< its name or id
    std::filesystem::path file;
};

/// `quarn sunpath`: draws the diagram, with what the model hides of the sky where there is one.
Outcome drawSunPath(const SunPathRequest& request, const CommonOptions& common);

} // namespace quarn::program
