#include "host/share/film/FilmWorker.h"

#include "engine/images/Opacity.h"

#include <utility>

namespace quarn {

namespace {

using Lock = std::unique_lock<std::mutex>;

/// Enough that drawing and encoding need not keep step from frame to frame.
constexpr std::size_t MOST_WAITING_BYTES = 64U << 20;

} // namespace

FilmWorker::FilmWorker(std::unique_ptr<FilmWriter> film)
    : m_film(std::move(film)), m_thread([this] { run(); }) {}

FilmWorker::~FilmWorker() {
    m_film->endSoon();
    {
        const Lock lock(m_mutex);
        m_is_dropped = true;
    }
    m_changed.notify_all();
    m_thread.join();
}

bool FilmWorker::hasRoom() const {
    const Lock lock(m_mutex);
    return m_waiting.size() < 2 || m_waiting_bytes < MOST_WAITING_BYTES;
}

void FilmWorker::add(const Image& picture, const std::string& caption) {
    Frame frame;
    {
        const Lock lock(m_mutex);
        if (!m_spare.empty()) {
            frame.picture = std::move(m_spare.back());
            m_spare.pop_back();
        }
    }
    frame.picture = picture;
    frame.caption = caption;
    {
        const Lock lock(m_mutex);
        m_waiting_bytes += picture.rgba.size();
        m_waiting.push_back(std::move(frame));
    }
    m_changed.notify_all();
}

void FilmWorker::close() {
    {
        const Lock lock(m_mutex);
        m_is_closed = true;
    }
    m_changed.notify_all();
}

bool FilmWorker::isIdle() const {
    const Lock lock(m_mutex);
    return m_is_done || (m_waiting.empty() && !m_is_at_work);
}

bool FilmWorker::isDone() const {
    const Lock lock(m_mutex);
    return m_is_done;
}

std::optional<Error> FilmWorker::failure() const {
    const Lock lock(m_mutex);
    return m_failure;
}

std::chrono::duration<double> FilmWorker::timeAtWork() const {
    const Lock lock(m_mutex);
    return m_time_at_work;
}

void FilmWorker::run() {
    using Clock = std::chrono::steady_clock;
    Frame frame;
    Image on_white;
    while (takeFrame(frame)) {
        const auto start = Clock::now();
        const auto added = m_film->add(onWhite(frame.picture, on_white), frame.caption);
        const Lock lock(m_mutex);
        m_time_at_work += Clock::now() - start;
        m_is_at_work = false;
        m_spare.push_back(std::move(frame.picture));
        if (!added) {
            m_failure = added.error();
            m_is_done = true;
            return;
        }
    }
    if (isDropped())
        return;
    const Result<void> finished = m_film->finish();
    const Lock lock(m_mutex);
    m_is_done = true;
    if (!finished)
        m_failure = finished.error();
}

bool FilmWorker::isDropped() const {
    const Lock lock(m_mutex);
    return m_is_dropped;
}

/// @return false where none comes any more
bool FilmWorker::takeFrame(Frame& frame) {
    Lock lock(m_mutex);
    m_changed.wait(lock, [&] { return !m_waiting.empty() || m_is_closed || m_is_dropped; });
    if (m_waiting.empty() || m_is_dropped)
        return false;
    frame = std::move(m_waiting.front());
    m_waiting.pop_front();
    m_is_at_work = true;
    m_waiting_bytes -= frame.picture.rgba.size();
    return true;
}

} // namespace quarn
