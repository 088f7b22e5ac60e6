#pragma once

#include "quarn/words/Outcome.h"

#include <optional>
#include <string>
#include <variant>
#include <vector>

namespace quarn::program {

/// What every command of the program takes.
struct CommonOptions {
    bool is_verbose = false;
    std::string language; ///< empty: the environment's
};

/// What every recording takes, as typed; an option that was not given is empty where it has no
/// default.
struct RecordingOptions {
    std::string model;
    std::string up_axis; ///< empty: by the format
    std::string folder;
    std::string size = "1280x720";
    std::string mode = "Rendered";
    std::string samples; ///< of a rendered picture's pixels; empty: as the document has it
    std::string format = "jpg";
    std::vector<std::string> hidden; ///< names of objects
    std::string name;
    bool was_name_given = false;
    std::string document; ///< to save
    bool was_document_given = false;
    bool shows_script = false;
    CommonOptions common;
};

/// `quarn turntable`
struct TurntableOptions {
    RecordingOptions recording;
    std::string frames;
    std::string direction = "clockwise";
    std::string elevation_deg = "22";
    std::string distance_factor;
    std::string target;
};

/// The ways to say what a camera, or its target, follows.
struct FollowedOptions {
    std::optional<std::string> object;     ///< name or id of a curve or a point
    std::optional<std::string> curve_file; ///< a file that holds a curve
    std::optional<std::string> point;      ///< a place where it stays
};

/// `quarn flythrough`
struct FlythroughOptions {
    RecordingOptions recording;
    std::string frames;
    FollowedOptions path;
    bool has_even_speed = false;
    std::string lens_mm;
};

/// `quarn path`
struct PathOptions {
    RecordingOptions recording;
    std::string frames;
    FollowedOptions camera;
    FollowedOptions target;
    bool has_even_speed = false;
    std::string lens_mm;
};

/// Where on the earth a model stands.
struct SiteOptions {
    std::optional<std::string> place;
    std::optional<std::string> latitude_deg;
    std::optional<std::string> longitude_deg;
    std::string north_deg = "0";
};

/// From where a sun study is seen.
struct StudyViewOptions {
    std::optional<std::string> view; ///< a standard view or a camera of the model
    std::optional<std::string> azimuth_deg;
    std::optional<std::string> elevation_deg;
    std::optional<std::string> distance_factor;
    std::optional<std::string> target;
};

/// `quarn day`
struct DayOptions {
    RecordingOptions recording;
    SiteOptions site;
    StudyViewOptions view;
    std::string date;
    std::string from = "06:00";
    std::string to = "20:00";
    std::string every = "15"; ///< minutes
};

/// `quarn season`
struct SeasonOptions {
    RecordingOptions recording;
    SiteOptions site;
    StudyViewOptions view;
    std::string from; ///< dates
    std::string to;
    std::string every = "7"; ///< days
    std::string at = "12:00";
};

/// `quarn places`
struct PlacesOptions {
    std::string text; ///< empty: all
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

/// `quarn curves`
struct CurvesOptions {
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
                             FrameOptions, FlythroughOptions, PathOptions, CurvesOptions,
                             DayOptions, SeasonOptions, PlacesOptions>;

/// Reads the program's arguments. Values are not looked into here.
Request readCommandLine(int argument_count, const char* const* arguments);

} // namespace quarn::program
