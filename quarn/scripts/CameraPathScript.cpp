#include "quarn/scripts/CameraPathScript.h"

#include "quarn/scripts/CameraToFit.h"

namespace quarn::program {

namespace {

/// What is followed, as the set-up commands find it.
/// @param role  "Camera" or "Target"
std::string objectName(const Followed& followed, const std::string& role) {
    if (!followed.curve_file.empty())
        return role + " curve";
    return followed.point ? role + " point" : followed.object;
}

std::string quotedName(const Followed& followed, const std::string& role) {
    return '"' + objectName(followed, role) + '"';
}

/// A document may hold what an earlier run made; the new takes its place.
void addMaking(const Followed& followed, const std::string& role, std::vector<std::string>& lines) {
    const std::string name = quotedName(followed, role);
    if (!followed.curve_file.empty())
        lines.push_back("_-ImportCurve [Replace] " + name + " " + quotedPath(followed.curve_file));
    if (followed.point)
        lines.push_back("_-Point _Replace " + name + " " + tripleText(*followed.point));
}

std::string lens(const CameraPathRequest& request) {
    return "_-Camera" + (request.lens_mm ? lensAnswer(*request.lens_mm) : " _Parallel=No") +
           " _Enter";
}

std::string setUp(const CameraPathRequest& request) {
    const std::string camera = quotedName(request.camera, "Camera");
    const std::string start = request.target ? "_-SetPathAnimation " + camera + " " +
                                                   quotedName(*request.target, "Target")
                                             : "_-SetFlythroughAnimation " + camera;
    return start + " " + std::to_string(request.recording.frames) + " " +
           sharedAnswers(request.recording);
}

} // namespace

AnimationLines cameraPathLines(const CameraPathRequest& request) {
    AnimationLines lines;
    addMaking(request.camera, "Camera", lines.preparing);
    if (request.target)
        addMaking(*request.target, "Target", lines.preparing);
    if (request.has_even_speed)
        lines.preparing.push_back("_-EvenSpeed " + quotedName(request.camera, "Camera"));
    lines.preparing.push_back(lens(request));
    lines.setting_up = {setUp(request)};
    return lines;
}

} // namespace quarn::program
