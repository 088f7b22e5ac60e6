#include "host/share/film/FolderFilm.h"

#include "host/app/ProcessorUse.h"
#include "host/recording/RecordedFolder.h"
#include "host/share/film/FilmCaption.h"
#include "host/share/frames/FramePicture.h"

#include <algorithm>

namespace quarn {

namespace {

/// A manifest may come from anywhere.
int frameRate(const FilmWish& wish, const FramesManifest& manifest) {
    if (wish.frame_rate > 0)
        return wish.frame_rate;
    const int rate = manifest.frame_rate > 0
                         ? manifest.frame_rate
                         : standardFrameRate(static_cast<int>(manifest.images.size()));
    return std::min(rate, filmKindOf(wish.file)->most_frames_a_second);
}

Result<void> addFrame(const RecordedFolder& recorded, const ManifestFrame& frame,
                      const FilmWish& wish, FilmMaking& making) {
    std::string caption;
    if (wish.has_caption) {
        auto text = captionOf(frame.sun, wish.file);
        if (!text)
            return text.error();
        caption = std::move(text.value());
    }
    const auto picture = readFramePicture(recorded.folder / frame.file);
    return picture ? making.add(picture.value(), caption) : picture.error();
}

} // namespace

Result<SharedFileReport> makeFilmOfFolder(const std::filesystem::path& folder, const FilmWish& wish,
                                          FrontEnd& front_end) {
    const auto recorded = readRecordedFolder(folder);
    if (!recorded)
        return recorded.error();
    for (const std::string& warning : recorded.value().warnings)
        front_end.warn(KM_wString::FromUtf8(warning).Array());
    const FramesManifest& manifest = recorded.value().manifest;
    const int frames = static_cast<int>(manifest.images.size());
    const int threads = mostThreads();
    FilmMaking making({wish, frames, frameRate(wish, manifest), threads > 1 ? threads : 0},
                      front_end);
    for (const ManifestFrame& frame : manifest.images) {
        front_end.sharedFileProgress(wish.file, 0.5 * making.framesTaken() / frames);
        front_end.pumpEvents(0);
        if (front_end.isInterrupted())
            break;
        if (const auto added = addFrame(recorded.value(), frame, wish, making); !added)
            return added.error();
    }
    return making.finish();
}

} // namespace quarn
