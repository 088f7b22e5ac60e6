#include "host/recording/RecordedFolder.h"

#include "ground/PathText.h"
#include "host/recording/FrameNames.h"
#include "host/recording/RecordingFile.h"
#include "sdk/qncore/QnLocalize.h"

#include <algorithm>
#include <array>
#include <map>
#include <set>

namespace quarn {

namespace {

namespace fs = std::filesystem;

constexpr std::string_view MANIFEST_END = ".frames.json";
constexpr std::string_view RECORDING_END = ".recording";
constexpr std::array<std::string_view, 5> EXTENSIONS = {"jpg", "jpeg", "png", "bmp", "tga"};

template <class... Arguments>
std::string sentence(const wchar_t* format, const Arguments&... arguments) {
    return KM_wString::FormatToString(format, arguments...).ToUtf8();
}

Error noRecording(const fs::path& folder) {
    return {sentence(QnLocalizeString(L"%s holds no recorded frames. Name a folder that a "
                                      L"recording was made into.",
                                      42696),
                     textFromPath(folder).Array())};
}

// ---- Which recordings there are

/// One recording in a folder: where its frames are listed, or how they are named.
struct Found {
    enum class By { manifest, recording_file, names } by;
    FrameNames names; ///< by their names alone; else the animation alone
};

using FileNames = std::set<std::string>;

FileNames filesIn(const fs::path& folder) {
    FileNames files;
    std::error_code error;
    for (fs::directory_iterator at(folder, error), end; !error && at != end; at.increment(error)) {
        std::error_code unknown;
        if (at->is_regular_file(unknown))
            files.insert(at->path().filename().native());
    }
    return files;
}

/// The animations that files of this ending tell of.
std::set<std::string> animationsBy(std::string_view end, const FileNames& files) {
    std::set<std::string> animations;
    for (const std::string& file : files)
        if (file.size() > end.size() && file.ends_with(end))
            animations.insert(file.substr(0, file.size() - end.size()));
    return animations;
}

/// The animation whose first frame has this name; nothing for every other file.
std::optional<FrameNames> namesByFirstFrame(const std::string& file) {
    for (const std::string_view extension : EXTENSIONS) {
        const std::string end = "000." + std::string(extension);
        if (file.size() > end.size() && file.ends_with(end))
            return FrameNames{file.substr(0, file.size() - end.size()), std::string(extension)};
    }
    return std::nullopt;
}

/// house1000.jpg is a frame of house, and not the first one of house1, where house000.jpg is there.
bool isLaterFrameOf(const std::vector<Found>& found, const std::string& file) {
    return std::ranges::any_of(
        found, [&](const Found& other) { return other.names.frameOf(file).has_value(); });
}

std::vector<Found> recordingsIn(const FileNames& files) {
    std::vector<Found> found;
    const std::set<std::string> with_manifest = animationsBy(MANIFEST_END, files);
    for (const std::string& animation : with_manifest)
        found.push_back({Found::By::manifest, {animation, {}}});
    for (const std::string& animation : animationsBy(RECORDING_END, files))
        if (!with_manifest.contains(animation))
            found.push_back({Found::By::recording_file, {animation, {}}});
    if (!found.empty())
        return found;
    for (const std::string& file : files)
        if (const auto names = namesByFirstFrame(file); names && !isLaterFrameOf(found, file))
            found.push_back({Found::By::names, *names});
    return found;
}

// ---- Its frames

/// What the names of the files tell of them.
void takeByNames(const FrameNames& names, const FileNames& files, FramesManifest& manifest) {
    std::map<int, std::string> frames;
    for (const std::string& file : files)
        if (const auto number = names.frameOf(file))
            frames[*number] = file;
    manifest.name = names.animation;
    manifest.extension = names.extension;
    manifest.frames = std::max(manifest.frames, frames.empty() ? 0 : frames.rbegin()->first + 1);
    manifest.frame_rate = standardFrameRate(manifest.frames);
    for (auto& [number, file] : frames) {
        manifest.images.push_back({});
        manifest.images.back().number = number;
        manifest.images.back().file = std::move(file);
    }
}

Result<FramesManifest> manifestByRecordingFile(const fs::path& folder, const std::string& animation,
                                               const FileNames& files) {
    const auto read = readRecordingFile(folder / recordingFileName(animation));
    if (!read)
        return read.error();
    if (!read.value())
        return noRecording(folder); // it was removed meanwhile
    const RecordingSettings& settings = read.value()->settings;
    FramesManifest manifest;
    manifest.kind = settings.kind;
    manifest.frames = settings.frames;
    manifest.width_px = settings.width_px;
    manifest.height_px = settings.height_px;
    manifest.mode = settings.mode;
    takeByNames({animation, settings.extension}, files, manifest);
    // An earlier recording of more frames may have left some.
    std::erase_if(manifest.images,
                  [&](const ManifestFrame& frame) { return frame.number >= settings.frames; });
    manifest.frames = settings.frames;
    manifest.frame_rate = standardFrameRate(manifest.frames);
    return manifest;
}

/// The extension of the frames of an animation whose manifest cannot be read.
FrameNames namesOf(const std::string& animation, const FileNames& files) {
    for (const std::string_view extension : EXTENSIONS) {
        const FrameNames names{animation, std::string(extension)};
        for (const std::string& file : files)
            if (names.frameOf(file))
                return names;
    }
    return {animation, std::string(EXTENSIONS.front())};
}

/// Also where the file that lists the frames is damaged: then it is told, and their names tell
/// what they can.
void takeFrames(const Found& found, const FileNames& files, RecordedFolder& recorded) {
    const std::string& animation = found.names.animation;
    if (found.by == Found::By::names)
        return takeByNames(found.names, files, recorded.manifest);
    auto manifest = found.by == Found::By::manifest
                        ? readFramesManifest(recorded.folder / manifestName(animation))
                        : manifestByRecordingFile(recorded.folder, animation, files);
    if (manifest) {
        recorded.manifest = std::move(manifest.value());
        recorded.has_manifest = found.by == Found::By::manifest;
        return;
    }
    recorded.warnings.push_back(manifest.message());
    takeByNames(namesOf(animation, files), files, recorded.manifest);
}

// ---- What is wrong with them

/// Lets go of frames that are not there, or empty.
void dropMissing(const FileNames& files, RecordedFolder& recorded) {
    std::erase_if(recorded.manifest.images, [&](const ManifestFrame& frame) {
        std::error_code error;
        return !files.contains(frame.file) ||
               fs::file_size(recorded.folder / frame.file, error) == 0;
    });
}

void tellMissing(RecordedFolder& recorded) {
    const FramesManifest& manifest = recorded.manifest;
    const int missing = manifest.frames - static_cast<int>(manifest.images.size());
    if (missing <= 0)
        return;
    int first = 0;
    for (const ManifestFrame& frame : manifest.images) {
        if (frame.number != first)
            break;
        ++first;
    }
    recorded.warnings.push_back(sentence(
        QnLocalizeString(L"%d of %d frames are missing in %s; the first is number %d.", 42693),
        missing, manifest.frames, textFromPath(recorded.folder).Array(), first));
}

void tellChanged(RecordedFolder& recorded) {
    const std::vector<ManifestFrame>& frames = recorded.manifest.images;
    const auto is_changed = [&](const ManifestFrame& frame) {
        std::error_code error;
        return fs::file_size(recorded.folder / frame.file, error) != frame.bytes;
    };
    const auto first = std::ranges::find_if(frames, is_changed);
    if (!recorded.has_manifest || first == frames.end())
        return;
    recorded.warnings.push_back(sentence(
        QnLocalizeString(L"%d of %d frames in %s were changed since they were recorded; the first "
                         L"is %s.",
                         42694),
        static_cast<int>(std::ranges::count_if(frames, is_changed)),
        static_cast<int>(frames.size()), textFromPath(recorded.folder).Array(),
        KM_wString::FromUtf8(first->file).Array()));
}

Error severalRecordings(const fs::path& folder, const std::vector<Found>& found) {
    const auto& [by, names] = found.front();
    const std::string one =
        by == Found::By::names
            ? names.fileName(0)
            : names.animation +
                  std::string(by == Found::By::manifest ? MANIFEST_END : RECORDING_END);
    return {sentence(QnLocalizeString(L"%s holds %d recordings. Name the file of one of them, such "
                                      L"as %s.",
                                      42695),
                     textFromPath(folder).Array(), static_cast<int>(found.size()),
                     textFromPath(folder / one).Array())};
}

/// The recording of a folder that a file in it belongs to.
std::vector<Found> recordingOf(const std::string& file, const FileNames& files) {
    for (const auto& [end, by] : {std::pair{MANIFEST_END, Found::By::manifest},
                                  std::pair{RECORDING_END, Found::By::recording_file}})
        if (file.size() > end.size() && file.ends_with(end))
            return {{by, {file.substr(0, file.size() - end.size()), {}}}};
    std::vector<Found> found = recordingsIn(files);
    std::erase_if(found, [&](const Found& one) {
        return !(one.by == Found::By::names ? one.names : namesOf(one.names.animation, files))
                    .frameOf(file);
    });
    return found;
}

} // namespace

Result<RecordedFolder> readRecordedFolder(const fs::path& folder) {
    RecordedFolder recorded;
    std::error_code error;
    const bool is_file = fs::is_regular_file(folder, error);
    recorded.folder = is_file ? folder.parent_path() : folder;
    if (recorded.folder.empty())
        recorded.folder = ".";
    if (!fs::is_directory(recorded.folder, error))
        return Error{sentence(QnLocalizeString(L"There is no folder %s.", 42697),
                              textFromPath(recorded.folder).Array())};
    const FileNames files = filesIn(recorded.folder);
    const std::vector<Found> found =
        is_file ? recordingOf(folder.filename().native(), files) : recordingsIn(files);
    if (found.size() > 1)
        return severalRecordings(recorded.folder, found);
    if (found.empty())
        return noRecording(recorded.folder);
    takeFrames(found.front(), files, recorded);
    dropMissing(files, recorded);
    if (recorded.manifest.images.empty())
        return noRecording(recorded.folder);
    tellMissing(recorded);
    tellChanged(recorded);
    return recorded;
}

} // namespace quarn
