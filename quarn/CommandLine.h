#pragma once

#include "quarn/Outcome.h"

#include <filesystem>
#include <string>
#include <variant>
#include <vector>

namespace quarn::program {

/// What every command of the program takes.
struct CommonOptions {
    bool is_verbose = false;
    std::string language; ///< empty: the environment's
};

/// `quarn turntable`, as typed; an option that was not given is empty where it has no default.
struct TurntableOptions {
    std::string model;
    std::string up_axis; ///< empty: by the format
    std::string folder;
    std::string frames;
    std::string size = "1280x720";
    std::string mode = "Rendered";
    std::string format = "jpg";
    std::string direction = "clockwise";
    std::string elevation_deg = "22";
    std::string distance_factor;
    std::string target;
    std::vector<std::string> hidden; ///< names of objects
    std::string name;
    bool was_name_given = false;
    std::string document; ///< to save
    bool was_document_given = false;
    bool shows_script = false;
    CommonOptions common;
};

/// `quarn frame`
struct FrameOptions {
    std::string document;
    std::string number;
    std::string size; ///< empty: the view's
    std::string file;
    bool shows_script = false;
    CommonOptions common;
};

/// `quarn run`
struct ScriptOptions {
    std::string script;
    std::string model; ///< empty: none is read first
    CommonOptions common;
};

/// `quarn info`
struct ModelOptions {
    std::string model;
    CommonOptions common;
};

/// `quarn console`
struct ConsoleOptions {
    std::string model; ///< empty: none is read first
    CommonOptions common;
};

/// What the program was asked for; an Outcome when that ended it already (help, or a mistake).
using Request = std::variant<Outcome, TurntableOptions, ScriptOptions, ModelOptions, ConsoleOptions,
                             FrameOptions>;

/// Reads the program's arguments. Values are not looked into here.
Request readCommandLine(int argument_count, const char* const* arguments);

} // namespace quarn::program
