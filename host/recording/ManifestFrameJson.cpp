#include "host/recording/ManifestFrameJson.h"

#include "ground/Checksum.h"

#include <charconv>

namespace quarn {

namespace {

using json = ManifestJson;

json jsonOf(const KM_3dPoint& point) {
    return {point.x, point.y, point.z};
}

json jsonOf(const FrameCamera& camera) {
    json object = {{"place", jsonOf(camera.place)},
                   {"target", jsonOf(camera.target)},
                   {"up", jsonOf(KM_3dPoint(camera.up))}};
    if (camera.is_parallel)
        object["extent"] = {camera.width, camera.height};
    else
        object["lens_mm"] = camera.lens_mm;
    return object;
}

json jsonOf(const FrameSun& sun) {
    return {{"time", sun.time},
            {"zone", sun.zone},
            {"azimuth_deg", sun.azimuth_deg},
            {"altitude_deg", sun.altitude_deg}};
}

KM_3dPoint pointOf(const json& value) {
    return {finiteOf(value.at(0)), finiteOf(value.at(1)), finiteOf(value.at(2))};
}

FrameCamera cameraOf(const json& object) {
    FrameCamera camera;
    camera.place = pointOf(object.at("place"));
    camera.target = pointOf(object.at("target"));
    camera.up = KM_3dVector(pointOf(object.at("up")));
    camera.is_parallel = object.contains("extent");
    if (camera.is_parallel) {
        camera.width = finiteOf(object["extent"].at(0));
        camera.height = finiteOf(object["extent"].at(1));
    } else {
        camera.lens_mm = finiteOf(object.at("lens_mm"));
    }
    return camera;
}

FrameSun sunOf(const json& object) {
    return {object.at("time"), object.at("zone"), finiteOf(object.at("azimuth_deg")),
            finiteOf(object.at("altitude_deg"))};
}

std::uint64_t hexadecimalOf(const std::string& text) {
    std::uint64_t number = 0;
    const char* const end = text.data() + text.size();
    const auto read = std::from_chars(text.data(), end, number, 16);
    if (read.ec != std::errc() || read.ptr != end)
        throw std::out_of_range("number");
    return number;
}

} // namespace

ManifestJson jsonOf(const ManifestFrame& frame) {
    json object = {{"frame", frame.number},
                   {"file", frame.file},
                   {"bytes", frame.bytes},
                   {"xxh64", checksumText(frame.xxh64)}};
    if (frame.camera)
        object["camera"] = jsonOf(*frame.camera);
    if (frame.sun)
        object["sun"] = jsonOf(*frame.sun);
    return object;
}

ManifestFrame manifestFrameOf(const ManifestJson& object) {
    ManifestFrame frame;
    frame.number = intOf(object.at("frame"));
    frame.file = fileNameOf(object.at("file"));
    frame.bytes = integerOf<std::uint64_t>(object.at("bytes"));
    frame.xxh64 = hexadecimalOf(object.at("xxh64"));
    if (object.contains("camera"))
        frame.camera = cameraOf(object["camera"]);
    if (object.contains("sun"))
        frame.sun = sunOf(object["sun"]);
    return frame;
}

std::string fileNameOf(const std::string& name) {
    if (name.empty() || name == "." || name == ".." || name.find('/') != std::string::npos ||
        name.find('\0') != std::string::npos)
        throw std::out_of_range("file name");
    return name;
}

} // namespace quarn
