#pragma once

#include "kelmar/KM_wString.h"

#include <cstdint>
#include <filesystem>
#include <functional>
#include <span>
#include <string>
#include <vector>

namespace quarn {

/// A place on the earth.
struct Place {
    double latitude_deg = 0.0;  ///< -90 to 90, north positive
    double longitude_deg = 0.0; ///< -180 to 180, east positive
};

/// A kind of file that a chooser offers.
struct FileKind {
    KM_wString label;                    ///< "Quarn documents", in the user's language
    std::vector<std::string> extensions; ///< without a dot, in lower case; none: every file
};

/// A file that a command asks a person for.
struct FileQuestion {
    enum class Kind { open, save };
    Kind kind = Kind::open;
    KM_wString title;                 ///< in the user's language
    std::vector<FileKind> file_kinds; ///< the first is offered first
    std::filesystem::path start;      ///< folder, or file that is offered; may be empty
};

/// What a person answered to a FileQuestion.
struct FileChoice {
    enum class Kind {
        chosen,
        given_up, ///< the chooser was closed
        nobody,   ///< there is no chooser: ask at the command line instead
    };
    Kind kind = Kind::nobody;
    std::filesystem::path file = {};
};

/// A picture for a window to show: 8-bit sRGB pixels, red, green, blue and opacity, rows from
/// top to bottom without gaps. Valid during the call that hands it over.
struct ShownPicture {
    int width_px = 0;
    int height_px = 0;
    std::span<const std::uint8_t> rgba = {};
};

/// The axis of a model file that points up.
enum class ModelUp { y, z };

/// Which axis of a model file points up, asked where neither the file nor its format says so.
struct UpAxisQuestion {
    std::filesystem::path file;
    ModelUp taken = ModelUp::z; ///< what most files of the kind have; stays where nobody chooses
    /// Draws the model as it stands with that axis up, from before it, to its right and above. The
    /// picture is valid until the next call; one of no size where the model cannot be drawn.
    std::function<ShownPicture(ModelUp up, int width_px, int height_px)> draw;
};

} // namespace quarn
