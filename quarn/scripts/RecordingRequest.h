#pragma once

#include "quarn/scripts/CaptureMode.h"
#include "quarn/scripts/FilmScript.h"
#include "quarn/scripts/LightScript.h"
#include "quarn/scripts/ViewerScript.h"
#include "quarn/words/Words.h"

#include <filesystem>
#include <optional>
#include <string>
#include <vector>

namespace quarn::program {

/// What every recording needs, whatever moves in it.
struct RecordingRequest {
    std::filesystem::path model;
    std::string up_axis;    ///< "y", "z" or, by the format, empty
    double tolerance = 0.0; ///< of curved surfaces, in model units; 0: by the model's size
    std::filesystem::path folder;
    bool has_own_folder = false; ///< nobody named the folder: it is the one beside the model
    std::string name;            ///< of the animation, its pictures and its page; UTF-8
    int frames = 0;
    PixelSize size{};
    CaptureMode mode;
    int samples = 0;            ///< of each pixel, by the render method; 0: as the document has it
    std::string format;         ///< "jpg", "png", "bmp" or "tga"
    std::optional<int> quality; ///< of jpg; 1 to 100; nothing: the host's
    LightRequest light;
    std::vector<std::string> hidden; ///< names of objects; UTF-8
    std::filesystem::path document;  ///< to save, a .quarn file; empty: none
    FilmRequest film;
    ViewerRequest viewer;
    /// Whether another recording in the folder is told instead of replaced.
    bool goes_on = false;
};

/// The path of the page that the recording writes.
inline std::filesystem::path pagePath(const RecordingRequest& request) {
    return request.folder / (request.name + ".html");
}

/// The path of the list of frames that it writes at its end.
inline std::filesystem::path framesPath(const RecordingRequest& request) {
    return request.folder / (request.name + ".frames.json");
}

} // namespace quarn::program
