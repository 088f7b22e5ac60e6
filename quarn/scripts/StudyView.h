#pragma once

#include "quarn/words/Words.h"

#include <optional>
#include <string>
#include <vector>

namespace quarn::program {

/// From where a sun study is seen; what is not there was not asked for.
struct StudyView {
    std::optional<std::string> name;     ///< of a standard view or a camera of the model
    std::optional<double> azimuth_deg;   ///< of the camera, clockwise from the Y axis
    std::optional<double> elevation_deg; ///< of the camera above its target, 0 to 89
    std::optional<double> distance_factor;
    std::optional<double> lens_mm; ///< of the perspective camera that it takes
    std::optional<Triple> target;

    /// Whether the named view is one that knows no lens.
    bool isParallel() const;
    /// Whether the camera is placed about a target, which a named view is not.
    bool aims() const { return azimuth_deg || elevation_deg || target; }
};

/// The host commands that take the camera there, one a line. The camera of a document is somebody's
/// choice: where nothing was asked for it stays.
std::vector<std::string> linesFor(const StudyView& view, bool is_of_document);

} // namespace quarn::program
