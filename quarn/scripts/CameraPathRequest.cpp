#include "quarn/scripts/CameraPathRequest.h"

namespace quarn::program {

namespace {

constexpr double SHORTEST_LENS_MM = 1.0; // as the command Camera takes them
constexpr double LONGEST_LENS_MM = 10000.0;

/// Wide enough that a person who walks through rooms and streets sees where the way goes.
constexpr double WALKING_LENS_MM = 24.0;

/// The options that say what is followed; an empty name stands for one that the command lacks.
struct FollowedNames {
    std::string object;
    std::string curve_file;
    std::string point;

    std::string alternatives() const {
        return object + " or " + curve_file + (point.empty() ? "" : " or " + point);
    }
};

std::optional<std::string> whyNotOne(const FollowedOptions& typed, const FollowedNames& names) {
    const int given =
        typed.object.has_value() + typed.curve_file.has_value() + typed.point.has_value();
    if (given == 0)
        return "say what to follow with " + names.alternatives() +
               "; quarn curves MODEL lists the curves and points of a model.";
    if (given > 1)
        return "give only one of " + names.alternatives() + ".";
    return std::nullopt;
}

Followed checkFollowed(const FollowedOptions& typed, const FollowedNames& names,
                       FirstMistake& mistake) {
    Followed followed;
    mistake.note(whyNotOne(typed, names));
    if (typed.object) {
        followed.object = *typed.object;
        mistake.note(whyPathIsRefused("the name of " + names.object, *typed.object));
    }
    if (typed.curve_file) {
        followed.curve_file = *typed.curve_file;
        mistake.note(whyPathIsRefused("the path of " + names.curve_file, *typed.curve_file));
    }
    if (typed.point) {
        followed.point = triple(*typed.point);
        if (!followed.point)
            mistake.note(names.point + " must be three numbers X,Y,Z without blanks" +
                         notBut(*typed.point));
    }
    return followed;
}

/// The lens of a document is somebody's choice; a model file has none.
std::optional<double> checkLens(const std::string& typed, const std::filesystem::path& model,
                                FirstMistake& mistake) {
    if (typed.empty())
        return isDocument(model) ? std::nullopt : std::optional(WALKING_LENS_MM);
    const std::optional<double> lens_mm = realNumber(typed);
    if (!lens_mm || *lens_mm < SHORTEST_LENS_MM || *lens_mm > LONGEST_LENS_MM)
        mistake.note("--lens must be a number of millimetres from 1 to 10000" + notBut(typed));
    return lens_mm;
}

void checkThatTheyDiffer(const Followed& camera, const Followed& target, FirstMistake& mistake) {
    if (lowerCase(camera.object) == lowerCase(target.object) &&
        camera.curve_file == target.curve_file && camera.point == target.point)
        mistake.note("camera and target must not be the same; quarn flythrough looks ahead along "
                     "one curve.");
}

/// What both commands take.
template <class Options>
CameraPathRequest checkCommon(const Options& options, FirstMistake& mistake) {
    CameraPathRequest request{};
    request.recording = checkRecording(options.recording, mistake);
    request.recording.frames = checkFrames(options.frames, mistake);
    request.has_even_speed = options.has_even_speed;
    request.lens_mm = checkLens(options.lens_mm, request.recording.model, mistake);
    return request;
}

std::variant<CameraPathRequest, Outcome> result(const CameraPathRequest& request,
                                                const FirstMistake& mistake) {
    if (mistake.text())
        return Outcome::misuse(*mistake.text());
    return request;
}

} // namespace

std::variant<CameraPathRequest, Outcome> checkFlythrough(const FlythroughOptions& options) {
    FirstMistake mistake;
    CameraPathRequest request = checkCommon(options, mistake);
    request.camera = checkFollowed(options.path, {"--path", "--camera-curve", ""}, mistake);
    return result(request, mistake);
}

std::variant<CameraPathRequest, Outcome> checkPath(const PathOptions& options) {
    FirstMistake mistake;
    CameraPathRequest request = checkCommon(options, mistake);
    request.camera =
        checkFollowed(options.camera, {"--camera", "--camera-curve", "--camera-point"}, mistake);
    request.target =
        checkFollowed(options.target, {"--target", "--target-curve", "--target-point"}, mistake);
    checkThatTheyDiffer(request.camera, *request.target, mistake);
    if (request.has_even_speed && request.camera.point)
        mistake.note("--even-speed is for a camera that follows a curve, not for --camera-point.");
    return result(request, mistake);
}

} // namespace quarn::program
