#include "host/share/film/FilmFollower.h"

#include "ground/PathText.h"
#include "host/app/Application.h"
#include "host/app/StudyMoments.h"
#include "host/document/Document.h"
#include "host/share/film/FilmCaption.h"
#include "host/share/frames/FramePicture.h"
#include "sdk/qncore/QnLocalize.h"
#include "sdk/qncore/QnZoetrixDynamicAccess.h"

#include <algorithm>

namespace quarn {

FilmFollower::FilmFollower(FilmWish wish, Application& application)
    : m_wish(std::move(wish)), m_application(application) {}

void FilmFollower::frameRecorded(const RecordedFrame& frame) {
    if (m_has_ended)
        return;
    if (const auto taken = take(frame.number, frame.picture); !taken)
        end(taken.error());
}

void FilmFollower::frameKept(int number, const std::filesystem::path& file) {
    if (m_has_ended)
        return;
    const auto picture = readFramePicture(file);
    const auto taken = picture ? take(number, picture.value()) : Result<void>(picture.error());
    if (!taken)
        end(taken.error());
}

Result<void> FilmFollower::take(int number, const Image& picture) {
    if (!m_making)
        begin();
    std::string caption;
    if (m_wish.has_caption) {
        auto text = captionOf(sunOfFrame(m_record, number, m_zone), m_wish.file);
        if (!text)
            return text.error();
        caption = std::move(text.value());
    }
    return m_making->add(picture, caption);
}

void FilmFollower::begin() {
    const IQnZoetrixDynamicAccess* const access = Zoetrix_QuarnDynamicAccess();
    Document* const document = m_application.documents().active();
    if (access && document) {
        m_record = access->AnimationProperties(document->face());
        m_zone = studyZone(*document, m_record);
    }
    const int frames = std::max(1, m_record.FrameCount());
    const int rate = m_wish.frame_rate > 0 ? m_wish.frame_rate : standardFrameRate(frames);
    m_making.emplace(FilmMaking::Plan{m_wish, frames, rate, threadsBesideDrawing()},
                     m_application.frontEnd());
}

/// The drawing has the processors, and what encodes beside it lives on what it leaves; but where
/// threads are counted it is one of them.
int FilmFollower::threadsBesideDrawing() {
    const int most_threads = m_application.options().most_threads;
    if (most_threads == 1)
        return 0;
    if (most_threads > 1)
        m_drawing_limit.emplace(tbb::global_control::max_allowed_parallelism,
                                static_cast<std::size_t>(most_threads - 1));
    return 1;
}

/// A film of which other programs make some of the frames would jump.
void FilmFollower::recordingEnded(const RecordingReport& report) {
    if (m_has_ended)
        return;
    if (report.elsewhere > 0)
        return end(Error{KM_wString::FormatToString(
                             QnLocalizeString(L"%s is not made: other programs record some of its "
                                              L"frames. Make it of the folder once all are there.",
                                              42863),
                             textFromPath(m_wish.file).Array())
                             .ToUtf8()});
    if (!m_making)
        begin();
    end(m_making->finish());
}

void FilmFollower::end(const Result<SharedFileReport>& made) {
    m_has_ended = true;
    m_making.reset();
    m_drawing_limit.reset();
    m_application.frontEnd().sharedFileEnded(
        made ? made.value()
             : SharedFileReport{m_wish.file, false, KM_wString::FromUtf8(made.message())});
}

} // namespace quarn
