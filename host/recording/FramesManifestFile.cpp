#include "ground/AtomicFile.h"
#include "ground/Checksum.h"
#include "ground/FileBytes.h"
#include "ground/PathText.h"
#include "host/recording/FramesManifest.h"
#include "host/recording/JsonNumbers.h"
#include "sdk/qncore/QnLocalize.h"

#include <charconv>

namespace quarn {

namespace {

using json = nlohmann::ordered_json;

constexpr const char* FORMAT_NAME = "quarn-frames";
constexpr int FORMAT_VERSION = 1;
/// A million frames take less.
constexpr std::uintmax_t LARGEST_FILE_BYTES = 1'000'000'000;

// ---- To JSON

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

json jsonOf(const ManifestFrame& frame) {
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

json headOf(const FramesManifest& manifest) {
    return {{"format", FORMAT_NAME},
            {"version", FORMAT_VERSION},
            {"program", manifest.program},
            {"name", manifest.name},
            {"kind", manifest.kind},
            {"frames", manifest.frames},
            {"width_px", manifest.width_px},
            {"height_px", manifest.height_px},
            {"mode", manifest.mode},
            {"extension", manifest.extension},
            {"frame_rate", manifest.frame_rate},
            {"metres_per_unit", manifest.metres_per_unit},
            {"document", manifest.document},
            {"settings", manifest.settings}};
}

std::string textOf(const json& object, int indent) {
    return object.dump(indent, ' ', false, json::error_handler_t::replace);
}

// ---- From JSON. What is not as it should be throws, which ends in parseFramesManifest.

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

/// Names of files in the folder, and nothing that leads out of it.
std::string fileNameOf(const std::string& name) {
    if (name.empty() || name == "." || name == ".." || name.find('/') != std::string::npos ||
        name.find('\0') != std::string::npos)
        throw std::out_of_range("file name");
    return name;
}

ManifestFrame frameOf(const json& object) {
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

FramesManifest manifestOf(const json& object) {
    FramesManifest manifest;
    manifest.program = object.at("program");
    manifest.name = fileNameOf(object.at("name"));
    manifest.kind = object.at("kind");
    manifest.frames = intOf(object.at("frames"));
    manifest.width_px = intOf(object.at("width_px"));
    manifest.height_px = intOf(object.at("height_px"));
    manifest.mode = object.at("mode");
    manifest.extension = object.at("extension");
    manifest.frame_rate = intOf(object.at("frame_rate"));
    manifest.metres_per_unit = finiteOf(object.at("metres_per_unit"));
    manifest.document = object.at("document");
    manifest.settings = object.at("settings");
    for (const json& image : object.at("images")) {
        manifest.images.push_back(frameOf(image));
        if (manifest.images.size() > 1 &&
            manifest.images.back().number <= manifest.images[manifest.images.size() - 2].number)
            throw std::out_of_range("order");
    }
    return manifest;
}

Error errorAbout(const std::filesystem::path& file, const wchar_t* text) {
    return {KM_wString::FormatToString(text, textFromPath(file).Array()).ToUtf8()};
}

Error isNoManifest(const std::filesystem::path& file) {
    return errorAbout(file,
                      QnLocalizeString(L"%s is damaged, or no list of recorded frames.", 42690));
}

} // namespace

/// One line a frame, so that people find theirs and tools that compare lines are of use.
std::string framesManifestText(const FramesManifest& manifest) {
    std::string text = textOf(headOf(manifest), 2);
    text.resize(text.size() - 2); // the line break and the brace
    text += ",\n  \"images\": [";
    const char* before = "\n    ";
    for (const ManifestFrame& frame : manifest.images) {
        text += before + textOf(jsonOf(frame), -1);
        before = ",\n    ";
    }
    return text + "\n  ]\n}\n";
}

Result<FramesManifest> parseFramesManifest(std::string_view text,
                                           const std::filesystem::path& file) {
    try {
        const json object = json::parse(text);
        if (object.at("format") != FORMAT_NAME)
            return isNoManifest(file);
        if (integerOf<std::int64_t>(object.at("version")) > FORMAT_VERSION)
            return errorAbout(
                file,
                QnLocalizeString(L"%s was written by a later version of the program.", 42691));
        return manifestOf(object);
    } catch (const json::exception&) {
        return isNoManifest(file);
    } catch (const std::out_of_range&) {
        return isNoManifest(file);
    }
}

Result<FramesManifest> readFramesManifest(const std::filesystem::path& file) {
    const Result<FileBytes> read = readFileBytes(file, LARGEST_FILE_BYTES);
    if (!read)
        return Error{KM_wString::FormatToString(QnLocalizeString(L"%s cannot be read: %s.", 42692),
                                                textFromPath(file).Array(),
                                                KM_wString::FromUtf8(read.message()).Array())
                         .ToUtf8()};
    const auto bytes = read.value().bytes();
    return parseFramesManifest({reinterpret_cast<const char*>(bytes.data()), bytes.size()}, file);
}

Result<void> writeFramesManifest(const std::filesystem::path& file,
                                 const FramesManifest& manifest) {
    const std::string text = framesManifestText(manifest);
    return writeFileAtomically(file, std::as_bytes(std::span(text)));
}

} // namespace quarn
