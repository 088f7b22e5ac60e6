#include "host/share/film/FilmMaking.h"

#include "ground/FileLinks.h"
#include "ground/PathText.h"
#include "host/letters/Letters.h"
#include "sdk/qncore/QnLocalize.h"

#include <algorithm>
#include <cerrno>
#include <cmath>
#include <cstring>
#include <utility>

namespace quarn {

namespace {

namespace fs = std::filesystem;

constexpr unsigned SHORT_WAIT_MS = 2;
constexpr unsigned PROGRESS_STEP_MS = 20;
/// So many encoded frames tell how long all will take; fewer would tell of the encoder's start.
constexpr int FRAMES_THAT_TELL_PACE = 8;
constexpr double SECONDS_WORTH_TELLING = 5.0;
constexpr mode_t OF_NEW_FILES = 0666; // less what the user's mask takes away

} // namespace

FilmMaking::FilmMaking(Plan plan, FrontEnd& front_end)
    : m_plan(std::move(plan)), m_front_end(front_end) {}

Error FilmMaking::cannotWrite(const std::string& why) const {
    return {KM_wString::FormatToString(QnLocalizeString(L"%s is not written: %s.", 42776),
                                       textFromPath(m_plan.wish.file).Array(),
                                       KM_wString::FromUtf8(why).Array())
                .ToUtf8()};
}

Result<void> FilmMaking::add(const Image& picture, const std::string& caption) {
    if (!m_worker)
        if (const auto begun = begin(picture); !begun)
            return begun;
    if (picture.width != m_frame_size.width_px || picture.height != m_frame_size.height_px)
        return Error{
            KM_wString::FormatToString(
                QnLocalizeString(L"%s is not written: a frame has %d x %d pixels, and the first "
                                 L"one %d x %d. Make a film of frames of one size.",
                                 42779),
                textFromPath(m_plan.wish.file).Array(), picture.width, picture.height,
                m_frame_size.width_px, m_frame_size.height_px)
                .ToUtf8()};
    waitForRoom();
    if (const auto failure = m_worker->failure())
        return cannotWrite(failure->message);
    m_worker->add(picture, caption);
    if (m_plan.threads == 0)
        waitForWorker();
    ++m_taken;
    tellPace();
    return {};
}

Result<void> FilmMaking::begin(const Image& first) {
    const FilmKindFacts& kind = *filmKindOf(m_plan.wish.file);
    m_frame_size = {first.width, first.height};
    m_size = filmSize(kind, m_frame_size, m_plan.wish.width_px);
    if (const auto begun = beginFile(); !begun)
        return begun;
    const int quality = m_plan.wish.quality > 0 ? m_plan.wish.quality : USUAL_FILM_QUALITY;
    const FilmForm form{kind.kind,
                        m_size.width_px,
                        m_size.height_px,
                        m_plan.frame_rate,
                        quality,
                        std::max(1, m_plan.threads),
                        m_plan.wish.has_caption ? programFont() : fs::path()};
    auto film = filmModule().value()->open(form, m_part->path());
    if (!film)
        return cannotWrite(film.message());
    m_worker.emplace(std::move(film.value()));
    return {};
}

Result<void> FilmMaking::beginFile() {
    const Result<fs::path> file = fileBehindLinks(m_plan.wish.file);
    if (!file)
        return cannotWrite(file.message());
    m_file = file.value();
    const fs::path folder = m_file.has_parent_path() ? m_file.parent_path() : ".";
    removeLeftParts(folder);
    m_part.emplace(folder, OF_NEW_FILES);
    return m_part->isOpen() ? Result<void>() : cannotWrite(std::strerror(errno));
}

void FilmMaking::waitForRoom() {
    while (!m_worker->hasRoom() && !m_worker->isDone())
        m_front_end.pumpEvents(SHORT_WAIT_MS);
}

void FilmMaking::waitForWorker() {
    while (!m_worker->isIdle())
        m_front_end.pumpEvents(SHORT_WAIT_MS);
}

/// Frames that were handed over are half of the work. Who asked the program to stop before has the
/// film of all of them.
void FilmMaking::waitForEnd() {
    const bool was_interrupted = m_front_end.isInterrupted();
    while (!m_worker->isDone()) {
        m_front_end.sharedFileProgress(m_plan.wish.file,
                                       0.5 + 0.5 * m_worker->framesEncoded() / m_taken);
        if (!was_interrupted && m_front_end.isInterrupted())
            m_worker->endSoon();
        m_front_end.pumpEvents(PROGRESS_STEP_MS);
    }
}

Result<SharedFileReport> FilmMaking::finish() {
    if (m_taken == 0)
        return Error{KM_wString::FormatToString(
                         QnLocalizeString(L"%s is not written: there is no frame to show.", 42780),
                         textFromPath(m_plan.wish.file).Array())
                         .ToUtf8()};
    m_worker->close();
    waitForEnd();
    if (const auto failure = m_worker->failure())
        return cannotWrite(failure->message);
    return giveName();
}

Result<SharedFileReport> FilmMaking::giveName() {
    if (!m_part->close() || !m_part->renameTo(m_file))
        return cannotWrite(std::strerror(errno));
    return report();
}

SharedFileReport FilmMaking::report() const {
    const int frames = m_worker->framesEncoded();
    std::error_code unknown;
    const auto bytes = static_cast<double>(fs::file_size(m_file, unknown));
    const wchar_t* const format =
        frames == 1
            ? QnLocalizeString(L"%s: %d frame of %d x %d pixels, %d a second, %.1f s long, %.2f MB",
                               42781)
            : QnLocalizeString(
                  L"%s: %d frames of %d x %d pixels, %d a second, %.1f s long, %.2f MB", 42782);
    return {m_plan.wish.file, true,
            KM_wString::FormatToString(format, textFromPath(m_plan.wish.file).Array(), frames,
                                       m_size.width_px, m_size.height_px, m_plan.frame_rate,
                                       static_cast<double>(frames) / m_plan.frame_rate,
                                       bytes / 1e6)};
}

void FilmMaking::tellPace() {
    const int encoded = m_worker->framesEncoded();
    if (m_has_told_pace || encoded < FRAMES_THAT_TELL_PACE ||
        !filmKindOf(m_plan.wish.file)->is_slow)
        return;
    m_has_told_pace = true;
    const double seconds = m_plan.frames * m_worker->timeAtWork().count() / encoded;
    if (seconds < SECONDS_WORTH_TELLING)
        return;
    const KM_wString text = KM_wString::FormatToString(
        QnLocalizeString(L"%s is of a kind that is encoded slowly: its %d frames take about %d s. "
                         L"A film that ends in .mp4 takes a fraction of that.",
                         42783),
        textFromPath(m_plan.wish.file).Array(), m_plan.frames,
        static_cast<int>(std::ceil(seconds)));
    m_front_end.warn(text.Array());
}

} // namespace quarn
