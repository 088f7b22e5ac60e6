#include "quarn/scripts/StudyView.h"

#include "quarn/scripts/CameraToFit.h"

#include <algorithm>
#include <array>

namespace quarn::program {

namespace {

/// From the right of a front that looks along the negative Y axis, and high enough to look down on
/// the shadows between the parts of a model.
constexpr double STUDY_AZIMUTH_DEG = 150.0;
constexpr double ELEVATION_DEG = 30.0;
/// Leaves room on the ground for shadows.
constexpr double DISTANCE_FACTOR = 1.1;

bool isStandardView(const std::string& name) {
    constexpr std::array<std::string_view, 4> NAMES = {"top", "front", "right", "perspective"};
    return std::ranges::find(NAMES, lowerCase(name)) != NAMES.end();
}

std::string fitView(const StudyView& view) {
    return std::string("_-FitView ") + (view.target ? "_KeepTarget=Yes " : "") + "_Distance " +
           numberText(view.distance_factor.value_or(DISTANCE_FACTOR)) + " _Enter";
}

std::string lens(const StudyView& view) {
    return "_-Camera" + lensAnswer(*view.lens_mm) + " _Enter";
}

/// A camera of the model is taken where it is, unless it is to be fitted.
std::vector<std::string> namedView(const StudyView& view) {
    std::vector<std::string> lines = {"_-StandardView \"" + *view.name + "\""};
    if (view.lens_mm)
        lines.push_back(lens(view));
    if (isStandardView(*view.name) || view.distance_factor)
        lines.push_back(fitView(view));
    return lines;
}

/// The camera of a document, but for what was asked for.
std::vector<std::string> ownView(const StudyView& view) {
    std::vector<std::string> lines;
    if (view.lens_mm)
        lines.push_back(lens(view));
    if (view.lens_mm || view.distance_factor)
        lines.push_back(fitView(view));
    return lines;
}

} // namespace

bool StudyView::isParallel() const {
    return name && isStandardView(*name) && lowerCase(*name) != "perspective";
}

std::vector<std::string> linesFor(const StudyView& view, bool is_of_document) {
    if (view.name)
        return namedView(view);
    if (is_of_document && !view.aims())
        return ownView(view);
    // The model's azimuth is a compass's, which runs the other way round from the Y axis.
    return {cameraToBeFitted(view.target.value_or(Triple{}),
                             90.0 - view.azimuth_deg.value_or(STUDY_AZIMUTH_DEG),
                             view.elevation_deg.value_or(ELEVATION_DEG), view.lens_mm),
            fitView(view)};
}

} // namespace quarn::program
