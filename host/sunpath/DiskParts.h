#pragma once

#include "host/letters/SheetWords.h"
#include "host/sunpath/Drawing.h"
#include "host/sunpath/Obstruction.h"
#include "host/sunpath/SkyDisk.h"
#include "host/sunpath/SunPaths.h"

#include <array>

namespace quarn {

/// The months by their index, from 0.
inline std::chrono::month monthAt(std::size_t index) {
    return std::chrono::month(static_cast<unsigned>(index) + 1);
}

/// The ways of the sun that a diagram shows.
struct YearOfPaths {
    std::array<SunPath, 12> days; ///< of the 21st of each month
    std::array<SunLoop, 24> hours;
};
YearOfPaths pathsOfYear(const SunSite& site, const StandardClock& clock);

/// Draws what is on one disk of the sky.
class DiskParts {
public:
    /// @param name  begins the names of shapes
    DiskParts(const SkyDisk& disk, std::string name, const SheetWords& words, Drawing& drawing)
        : m_disk(disk), m_name(std::move(name)), m_words(words), m_drawing(drawing) {}

    void addSky();
    void addHidden(const Obstruction& obstruction);
    /// The rings and rays of whole tens of degrees, and the horizon.
    void addRings();
    void addLoops(const YearOfPaths& year);
    /// The ways of the days, with their dates at the horizon.
    void addDays(const YearOfPaths& year);
    void addAltitudes(const SunSite& site);
    /// The hours beside their loops.
    void addHours(const YearOfPaths& year, const SunSite& site);
    void addCompass();

private:
    void addPath(const std::string& id, const SunPath& path, const DrawnStroke& stroke);
    void addDate(std::size_t month, const SunPath& path);
    void addTextAt(const DrawnPoint& middle, DrawnText text);

    SkyDisk m_disk;
    std::string m_name;
    const SheetWords& m_words;
    Drawing& m_drawing;
};

} // namespace quarn
