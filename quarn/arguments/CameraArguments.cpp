// The recordings whose camera moves.
#include "quarn/arguments/Readings.h"
#include "quarn/arguments/RecordingArguments.h"
#include "quarn/arguments/Subcommands.h"
#include "quarn/scripts/CameraPathScript.h"
#include "quarn/scripts/TurntableScript.h"

namespace quarn::program {

namespace {

/// Wide enough that a person who walks through rooms and streets sees where the way goes.
constexpr double WALKING_LENS_MM = 24.0;

using AskedPath = Asked<CameraPathRequest>;

/// What the cameras that follow something have in common.
void addTravelOptions(CLI::App& command, AskedPath& asked) {
    const OptionAdder add(command);
    CameraPathRequest& request = asked.request;
    command.add_flag("--even-speed", request.has_even_speed,
                     "Run through the camera's curve at even speed, whatever its parameters");
    addFrames(add, request.recording, "Pictures from the start to the end, from 1");
    addLens(add, request.lens_mm, "(default: 24, which suits a walk; a document's own)");
    addRecordingOptions(command, request.recording, asked.use);
}

/// @param options  their names: "--path or --camera-curve"
std::optional<std::string> whyNotOne(const Followed& followed, const std::string& options) {
    const int given = !followed.object.empty() + !followed.curve_file.empty() +
                      static_cast<int>(followed.point.has_value());
    if (given == 0)
        return "say what to follow with " + options +
               "; quarn curves MODEL lists the curves and points of a model.";
    if (given > 1)
        return "give only one of " + options + ".";
    return std::nullopt;
}

bool areTheSame(const Followed& camera, const Followed& target) {
    return lowerCase(camera.object) == lowerCase(target.object) &&
           camera.curve_file == target.curve_file && camera.point == target.point;
}

std::optional<std::string> settleFlythrough(CameraPathRequest& request) {
    if (auto mistake = settle(request.recording))
        return mistake;
    return whyNotOne(request.camera, "--path or --camera-curve");
}

std::optional<std::string> settlePath(CameraPathRequest& request) {
    if (auto mistake = settle(request.recording))
        return mistake;
    if (auto mistake = whyNotOne(request.camera, "--camera or --camera-curve or --camera-point"))
        return mistake;
    if (auto mistake = whyNotOne(*request.target, "--target or --target-curve or --target-point"))
        return mistake;
    if (areTheSame(request.camera, *request.target))
        return "camera and target must not be the same; quarn flythrough looks ahead along one "
               "curve.";
    if (request.has_even_speed && request.camera.point)
        return "--even-speed is for a camera that follows a curve, not for --camera-point.";
    return std::nullopt;
}

/// The lens of a document is somebody's choice; a model file has none.
Outcome recordCameraPath(AskedPath& asked, const std::optional<std::string>& mistake) {
    CameraPathRequest& request = asked.request;
    if (mistake)
        return Outcome::misuse(*mistake);
    if (!request.lens_mm && !isDocument(request.recording.model))
        request.lens_mm = WALKING_LENS_MM;
    return recordOrShow(request.recording, cameraPathLines(request), asked.use);
}

void addTurntableOptions(CLI::App& command, Asked<TurntableRequest>& asked) {
    TurntableRequest& request = asked.request;
    const OptionAdder add(command);
    addModelAndFolder(add, request.recording);
    addFrames(add, request.recording, "Pictures of one whole turn, from 1");
    add("--direction", request.direction, "NAME", oneOf({"clockwise", "anticlockwise"}),
        "Way that the model seems to turn, seen from above, clockwise or anticlockwise; the "
        "camera goes round it the other way",
        "clockwise");
    add("--start-angle", request.start_angle_deg, "DEG", numberFrom(-360, 360, "degrees"),
        "Where the camera of the first picture stands, seen from above: anticlockwise from the X "
        "axis (default: in front and to the right)");
    add("--elevation", request.elevation_deg, "DEG", numberFrom(-89, 89, "degrees"),
        "Angle of the camera above the model, -89 to 89", "22");
    add("--distance", request.distance_factor, "FACTOR", numberFrom(0.01, 1000),
        "Camera distance times this: 0.01 to 1000, below 1 is nearer");
    addLens(add, request.lens_mm, "(default: 50; a document's own); the model fills the picture");
    add("--target", request.target, "X,Y,Z", point(),
        "Point to turn about (default: the model's middle)");
    addRecordingOptions(command, request.recording, asked.use);
}

/// A page that can be sent alone, and a film beside it.
std::optional<std::string> settleShared(RecordingRequest& request) {
    request.viewer.is_wanted = request.viewer.is_one_file = true;
    const bool has_own_film = request.film.file.empty();
    if (has_own_film)
        request.film.file = "film.mp4"; // its place is known when the folder is
    if (auto mistake = settle(request))
        return mistake;
    if (has_own_film)
        request.film.file = request.folder / (request.name + ".mp4");
    return std::nullopt;
}

Outcome recordTurntable(const Asked<TurntableRequest>& asked,
                        const std::optional<std::string>& mistake) {
    if (mistake)
        return Outcome::misuse(*mistake);
    return recordOrShow(asked.request.recording, turntableLines(asked.request), asked.use);
}

} // namespace

Action addTurntable(CLI::App& command) {
    const auto asked = std::make_shared<Asked<TurntableRequest>>();
    addTurntableOptions(command, *asked);
    return [asked] { return recordTurntable(*asked, settle(asked->request.recording)); };
}

Action addShare(CLI::App& command) {
    const auto asked = std::make_shared<Asked<TurntableRequest>>();
    addTurntableOptions(command, *asked);
    return [asked] { return recordTurntable(*asked, settleShared(asked->request.recording)); };
}

Action addFlythrough(CLI::App& command) {
    const auto asked = std::make_shared<AskedPath>();
    const OptionAdder add(command);
    Followed& camera = asked->request.camera;
    addModelAndFolder(add, asked->request.recording);
    add("--path", camera.object, "NAME", scriptWord("the name of --path"),
        "Curve to follow, by its name or id");
    add("--camera-curve", camera.curve_file, "FILE", scriptWord("the path of --camera-curve"),
        "Follow the curve in this file instead");
    addTravelOptions(command, *asked);
    return [asked] { return recordCameraPath(*asked, settleFlythrough(asked->request)); };
}

Action addPath(CLI::App& command) {
    const auto asked = std::make_shared<AskedPath>();
    const OptionAdder add(command);
    Followed& camera = asked->request.camera;
    Followed& target = asked->request.target.emplace();
    addModelAndFolder(add, asked->request.recording);
    add("--camera", camera.object, "NAME", scriptWord("the name of --camera"),
        "Curve or point that the camera follows, by its name or id");
    add("--camera-curve", camera.curve_file, "FILE", scriptWord("the path of --camera-curve"),
        "Or: the curve in this file");
    add("--camera-point", camera.point, "X,Y,Z", point(), "Or: the place where the camera stays");
    add("--target", target.object, "NAME", scriptWord("the name of --target"),
        "Curve or point that the camera looks at, by its name or id");
    add("--target-curve", target.curve_file, "FILE", scriptWord("the path of --target-curve"),
        "Or: the curve in this file");
    add("--target-point", target.point, "X,Y,Z", point(), "Or: the place that it looks at");
    addTravelOptions(command, *asked);
    return [asked] { return recordCameraPath(*asked, settlePath(asked->request)); };
}

} // namespace quarn::program
