#include "quarn/arguments/StudyViewArguments.h"

#include "quarn/arguments/Readings.h"
#include "quarn/arguments/RecordingArguments.h"

namespace quarn::program {

void addStudyView(const OptionAdder& add, StudyView& view, const std::string& views) {
    add("--view", view.name, "NAME", scriptWord("the name of --view"),
        views + ", in place of the next options");
    add("--azimuth", view.azimuth_deg, "DEG", numberFrom(-360, 360, "degrees"),
        "Where the camera stands, clockwise from the Y axis (default: 150, in front and to the "
        "right)");
    add("--elevation", view.elevation_deg, "DEG", numberFrom(0, 89, "degrees"),
        "Angle of the camera above the model, 0 to 89 (default: 30)");
    add("--target", view.target, "X,Y,Z", point(),
        "Point to look at (default: the model's middle)");
    add("--distance", view.distance_factor, "FACTOR", numberFrom(0.01, 1000),
        "Distance of the camera, 1 where the model just fits into the picture (default: 1.1)");
    addLens(add, view.lens_mm, "(default: 50; a document's own)");
}

std::optional<std::string> whyViewIsRefused(const StudyView& view, bool is_parallel) {
    if (view.name && view.aims())
        return "--view takes the place of --azimuth, --elevation and --target.";
    if (view.lens_mm && is_parallel)
        return "--lens is for perspective views; --view " + *view.name + " has none.";
    return std::nullopt;
}

} // namespace quarn::program
