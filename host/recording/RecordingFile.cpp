#include "host/recording/RecordingFile.h"

#include "ground/FileBytes.h"
#include "ground/PathText.h"
#include "host/recording/JsonNumbers.h"
#include "sdk/qncore/QnLocalize.h"

namespace quarn {

namespace {

using RecordingJson = nlohmann::json;

constexpr const char* format_name = "quarn-recording";
constexpr int format_version = 2;

// ---- To JSON

RecordingJson jsonOf(const FrameSet& frames) {
    RecordingJson ranges = RecordingJson::array();
    for (const FrameSet::Range& range : frames.ranges())
        ranges.push_back({range.first, range.last});
    return ranges;
}

RecordingJson jsonOf(const PicturesByExtension& pictures) {
    RecordingJson object = RecordingJson::object();
    for (const auto& [extension, frames] : pictures)
        object[extension] = jsonOf(frames);
    return object;
}

RecordingJson jsonOf(const RecordingSettings& settings) {
    return {{"kind", settings.kind},
            {"frames", settings.frames},
            {"width_px", settings.width_px},
            {"height_px", settings.height_px},
            {"mode", settings.mode},
            {"extension", settings.extension},
            {"jpeg_quality", settings.jpeg_quality}};
}

RecordingJson jsonOf(const RecordingFingerprint& fingerprint) {
    return {{"program", fingerprint.program},
            {"document", fingerprint.document},
            {"settings", fingerprint.settings},
            {"instructions", fingerprint.instructions}};
}

RecordingJson jsonOf(const RecordingFile& recording) {
    return {{"format", format_name},
            {"version", format_version},
            {"name", recording.animation},
            {"document_file", recording.document.native()},
            {"state", recording.is_running ? "recording" : "ended"},
            {"shared", recording.is_shared},
            {"writer",
             {{"host", recording.writer.host},
              {"pid", recording.writer.pid},
              {"started", recording.writer.started}}},
            {"settings", jsonOf(recording.settings)},
            {"fingerprint", jsonOf(recording.fingerprint)},
            {"written", jsonOf(recording.written)},
            {"owns_page", recording.owns_page},
            {"earlier", jsonOf(recording.earlier)}};
}

// ---- From JSON. What has another type than it should throws, which ends in parseRecording.

FrameSet framesOf(const RecordingJson& ranges) {
    FrameSet frames;
    int before = -1;
    for (const RecordingJson& range : ranges) {
        const int first = intOf(range.at(0));
        const int last = intOf(range.at(1));
        if (first <= before || first > last)
            throw std::out_of_range("range");
        frames.add(FrameSet::Range{first, last});
        before = last;
    }
    return frames;
}

PicturesByExtension picturesOf(const RecordingJson& object) {
    PicturesByExtension pictures;
    for (const auto& [extension, frames] : object.items())
        pictures[extension] = framesOf(frames);
    return pictures;
}

RecordingSettings settingsOf(const RecordingJson& object) {
    return {object.at("kind"),
            intOf(object.at("frames")),
            intOf(object.at("width_px")),
            intOf(object.at("height_px")),
            object.at("mode"),
            object.at("extension"),
            object.contains("jpeg_quality") ? intOf(object["jpeg_quality"]) : 0};
}

RecordingFingerprint fingerprintOf(const RecordingJson& object) {
    return {object.at("program"), object.at("document"), object.at("settings"),
            object.at("instructions")};
}

RecordingFile recordingOf(const RecordingJson& object) {
    RecordingFile recording;
    recording.animation = object.at("name");
    recording.is_running = object.at("state") == "recording";
    const RecordingJson& writer = object.at("writer");
    recording.writer = {writer.at("host"), intOf(writer.at("pid")),
                        integerOf<std::uint64_t>(writer.at("started"))};
    recording.settings = settingsOf(object.at("settings"));
    recording.document = object.value("document_file", "");
    recording.is_shared = object.value("shared", false);
    if (object.contains("fingerprint"))
        recording.fingerprint = fingerprintOf(object["fingerprint"]);
    recording.written = framesOf(object.at("written"));
    recording.owns_page = object.at("owns_page");
    recording.earlier = picturesOf(object.at("earlier"));
    return recording;
}

Error notARecording(const std::filesystem::path& file) {
    return {KM_wString::FormatToString(
                QnLocalizeString(L"%s does not tell of a recording, so it cannot be seen which "
                                 L"pictures may be replaced. Move that file away, record into "
                                 L"another folder or under another name, or start the program with "
                                 L"--overwrite.",
                                 42533),
                textFromPath(file).Array())
                .ToUtf8()};
}

Error ofALaterVersion(const std::filesystem::path& file) {
    return {KM_wString::FormatToString(
                QnLocalizeString(L"%s was written by a later version of the program. Record with "
                                 L"that one, into another folder or under another name.",
                                 42534),
                textFromPath(file).Array())
                .ToUtf8()};
}

/// Even a recording of many pieces takes a small part of this.
constexpr std::uintmax_t largest_file_bytes = 64'000'000;

} // namespace

Result<RecordingFile> parseRecordingFile(std::string_view text, const std::filesystem::path& file) {
    try {
        const RecordingJson object = RecordingJson::parse(text);
        if (object.at("format") != format_name)
            return notARecording(file);
        if (integerOf<std::int64_t>(object.at("version")) > format_version)
            return ofALaterVersion(file);
        return recordingOf(object);
    } catch (const RecordingJson::exception&) {
        return notARecording(file);
    } catch (const std::out_of_range&) {
        return notARecording(file);
    }
}

std::string recordingFileText(const RecordingFile& recording) {
    return jsonOf(recording).dump(2, ' ', false, RecordingJson::error_handler_t::replace) + "\n";
}

Result<std::optional<RecordingFile>> readRecordingFile(const std::filesystem::path& file) {
    std::error_code error;
    if (!std::filesystem::exists(std::filesystem::symlink_status(file, error)))
        return std::optional<RecordingFile>();
    if (std::filesystem::file_size(file, error) > largest_file_bytes)
        return notARecording(file);
    const Result<FileBytes> read = readFileBytes(file);
    if (!read)
        return notARecording(file);
    const auto bytes = read.value().bytes();
    auto recording =
        parseRecordingFile({reinterpret_cast<const char*>(bytes.data()), bytes.size()}, file);
    if (!recording)
        return recording.error();
    return std::optional(std::move(recording.value()));
}

Result<void> writeRecordingFile(const std::filesystem::path& file, const RecordingFile& recording,
                                Protection protection) {
    const std::string text = recordingFileText(recording);
    return writeFileAtomically(file, std::as_bytes(std::span(text)), protection);
}

} // namespace quarn
