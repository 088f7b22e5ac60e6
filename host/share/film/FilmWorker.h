#pragma once

#include "engine/images/Image.h"
#include "host/share/film/FilmModule.h"

#include <chrono>
#include <condition_variable>
#include <deque>
#include <mutex>
#include <optional>
#include <thread>
#include <vector>

namespace quarn {

/// Encodes a film, whose frames are seen on white where they are see-through, on a thread of its
/// own, beside whatever makes its frames. One thread hands them over and asks.
class FilmWorker {
public:
    explicit FilmWorker(std::unique_ptr<FilmWriter> film);
    /// Drops what was not encoded.
    ~FilmWorker();
    FilmWorker(const FilmWorker&) = delete;
    FilmWorker& operator=(const FilmWorker&) = delete;

    /// Whether a frame can be handed over now without taking more memory than is meant for them.
    bool hasRoom() const;
    /// Hands a copy of a frame over.
    void add(const Image& picture, const std::string& caption);
    /// No more frames come.
    void close();
    /// Ends the film soon, with the frames that are encoded by then.
    void endSoon() { m_film->endSoon(); }

    /// Whether all that was handed over is at the encoder, and the thread waits for more.
    bool isIdle() const;
    /// Whether nothing more happens: the film is written, or could not be.
    bool isDone() const;
    /// Why it could not be, a part of a sentence; nothing where all went well so far.
    std::optional<Error> failure() const;
    int framesEncoded() const { return m_film->framesEncoded(); }
    /// For how long it was at work.
    std::chrono::duration<double> timeAtWork() const;

private:
    struct Frame {
        Image picture;
        std::string caption;
    };

    void run();
    bool takeFrame(Frame& frame);
    bool isDropped() const;

    std::unique_ptr<FilmWriter> m_film;
    mutable std::mutex m_mutex; ///< of all that follows but the thread
    std::condition_variable m_changed;
    std::deque<Frame> m_waiting;
    std::vector<Image> m_spare; ///< of frames that are encoded, whose memory serves again
    std::size_t m_waiting_bytes = 0;
    bool m_is_closed = false;
    bool m_is_dropped = false;
    bool m_is_at_work = false;
    bool m_is_done = false;
    std::optional<Error> m_failure;
    std::chrono::duration<double> m_time_at_work{};
    std::thread m_thread;
};

} // namespace quarn
