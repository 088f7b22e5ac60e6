#pragma once

#include "host/almanac/CivilSite.h"
#include "host/almanac/DayTimes.h"

#include <chrono>
#include <filesystem>
#include <optional>
#include <string>

namespace quarn {

/// What hours of sun are asked for, of which picture, and where they go.
struct SunHoursRequest {
    std::string title; ///< UTF-8: of the model
    CivilSite site;

    std::chrono::year_month_day first_day{};
    std::chrono::year_month_day last_day{};
    int every_days = 1;             ///< from 1
    std::optional<WantedTime> from; ///< of each day; none: midnight
    std::optional<WantedTime> to;   ///< none: the midnight that ends the day
    int every_minutes = 10;         ///< from 1

    bool is_plan = false; ///< straight from above; else as the active view sees it
    int width_px = 1280;
    int height_px = 720;
    double isoline_hours = 0.0; ///< between lines of equal hours; 0: none
    double threshold_hours = 2.0;
    double grid_size = 0.0; ///< in units of the model; 0: no grid is written

    std::filesystem::path folder;
    std::string name; ///< what the files' names begin with
};

} // namespace quarn
