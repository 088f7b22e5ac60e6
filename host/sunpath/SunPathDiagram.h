#pragma once

#include "host/letters/SheetWords.h"
#include "host/sunpath/Drawing.h"
#include "host/sunpath/Obstruction.h"
#include "host/sunpath/SkyDisk.h"
#include "host/sunpath/SunPaths.h"

#include <optional>
#include <string>
#include <vector>

namespace quarn {

/// The point of a model that a diagram is of.
struct DiagramPoint {
    std::string name; ///< of an object, or "1,2,3"
    bool is_object;
    std::string model; ///< "house.glb"
    Obstruction obstruction;
};

/// What clocks show in summer.
struct SummerTime {
    std::string name;           ///< "CEST"
    std::chrono::minutes ahead; ///< of standard time
};

/// A sun path diagram, as somebody wants it.
struct SunPathWish {
    std::string place; ///< "Berlin, Germany"; empty: its coordinates alone name it
    SunSite site;
    StandardClock clock;    ///< of a year that SunYears.h names
    std::string clock_name; ///< "UTC+1 (CET)"
    std::optional<SummerTime> summer_time;
    std::vector<SkyProjection> projections; ///< side by side
    std::optional<double> north_deg;        ///< of the model, clockwise from its Y axis, to show it
    std::optional<DiagramPoint> point;
};

/// Draws the ways of the sun over a place through a year: the sky as a disk with its compass and
/// rings of altitude, the sun's way on the 21st of each month, its loop at each whole hour of
/// standard time, and in grey what hides the sky from a point of a model. Ways and loops are named
/// shapes: "stereographic-03-21", "orthographic-hour-12"; what is hidden is
/// "stereographic-hidden".
Drawing sunPathDiagram(const SunPathWish& wish, const SheetWords& words);

} // namespace quarn
