#pragma once

#include "host/front_end/FrontEnd.h"
#include "import/ReadingWatch.h"

#include <chrono>
#include <filesystem>
#include <thread>

namespace quarn {

/// Lets the front end work on its events while a model file is read and its scene is built, and
/// shows how far that is where it takes longer than a moment. The person ends it with Escape or by
/// asking the program to stop.
class WatchedReading final : public ReadingWatch {
public:
    WatchedReading(FrontEnd& front_end, std::filesystem::path file)
        : m_front_end(front_end), m_file(std::move(file)) {}
    /// Tells the front end that the reading has ended, where it was told of it.
    ~WatchedReading() override;
    WatchedReading(const WatchedReading&) = delete;
    WatchedReading& operator=(const WatchedReading&) = delete;

    bool goesOn(ReadingStep step, double share) override;
    /// The same of the building of the scene, on the thread of the front end.
    bool buildingGoesOn(double share) { return goesOn(ModelStep::built, share); }
    bool isGivenUp() const { return m_is_given_up; }

private:
    bool goesOn(ModelStep step, double share);

    FrontEnd& m_front_end;
    std::filesystem::path m_file;
    std::thread::id m_thread = std::this_thread::get_id();
    std::chrono::steady_clock::time_point m_begin = std::chrono::steady_clock::now();
    bool m_is_shown = false;
    bool m_is_given_up = false;
};

} // namespace quarn
