#include "ground/AtomicFile.h"
#include "ground/FileBytes.h"
#include "ground/PathText.h"
#include "host/recording/ManifestFrameJson.h"
#include "sdk/qncore/QnLocalize.h"

namespace quarn {

namespace {

using json = ManifestJson;

constexpr const char* FORMAT_NAME = "quarn-frames";
constexpr int FORMAT_VERSION = 1;
/// A million frames take less.
constexpr std::uintmax_t LARGEST_FILE_BYTES = 1'000'000'000;

// ---- To JSON

json headOf(const FramesManifest& manifest) {
    json head{{"format", FORMAT_NAME},
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
              {"metres_per_unit", manifest.metres_per_unit}};
    if (!manifest.place.empty())
        head["place"] = manifest.place;
    head["document"] = manifest.document;
    head["settings"] = manifest.settings;
    head["instructions"] = manifest.instructions;
    return head;
}

std::string textOf(const json& object, int indent) {
    return object.dump(indent, ' ', false, json::error_handler_t::replace);
}

// ---- From JSON. What is not as it should be throws, which ends in parseFramesManifest.

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
    manifest.place = object.value("place", "");
    manifest.document = object.at("document");
    manifest.settings = object.at("settings");
    manifest.instructions = object.value("instructions", "");
    for (const json& image : object.at("images")) {
        manifest.images.push_back(manifestFrameOf(image));
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
