#include "host/sunpath/Obstruction.h"

#include "engine/sunhours/SkyRays.h"
#include "host/sun/SunDirection.h"

#include <algorithm>
#include <cmath>

namespace quarn {
namespace {

constexpr std::size_t LINES = 1440;
constexpr int STEPS_OF_LINE = 180;

class Looking {
public:
    Looking(const DisplayScene& scene, const SkyWatch& watch)
        : m_north_deg(watch.north_deg), m_rays(scene, watch.point, watch.absent_mesh) {}

    bool isHidden(double azimuth_deg, double altitude_deg) {
        return m_rays.isHidden(directionToSun({azimuth_deg + m_north_deg, altitude_deg}));
    }

    /// The altitude at which what is hidden begins or ends between two.
    double border(double azimuth_deg, double low_deg, double high_deg) {
        constexpr double FINE_DEG = 0.01;
        const bool is_hidden_below = isHidden(azimuth_deg, low_deg);
        while (high_deg - low_deg > FINE_DEG) {
            const double middle_deg = (low_deg + high_deg) / 2;
            (isHidden(azimuth_deg, middle_deg) == is_hidden_below ? low_deg : high_deg) =
                middle_deg;
        }
        return (low_deg + high_deg) / 2;
    }

    std::vector<Obstruction::Band> line(double azimuth_deg) {
        std::vector<Obstruction::Band> bands;
        bool was_hidden = false;
        double last_deg = 0;
        for (int step = 0; step <= STEPS_OF_LINE; ++step) {
            const double altitude_deg = 90.0 * step / STEPS_OF_LINE;
            const bool is_hidden = isHidden(azimuth_deg, altitude_deg);
            if (is_hidden != was_hidden) {
                const double border_deg =
                    step == 0 ? 0 : border(azimuth_deg, last_deg, altitude_deg);
                if (is_hidden)
                    bands.push_back({border_deg, 90});
                else
                    bands.back().high_deg = border_deg;
            }
            was_hidden = is_hidden;
            last_deg = altitude_deg;
        }
        return bands;
    }

private:
    double m_north_deg;
    SkyRays m_rays;
};

using Band = Obstruction::Band;

bool doTouch(const Band& one, const Band& other) {
    return one.low_deg <= other.high_deg && other.low_deg <= one.high_deg;
}

/// Something hidden that goes on from line to line.
struct Strip {
    std::vector<double> azimuths_deg;
    std::vector<Band> bands;

    void add(double azimuth_deg, const Band& band) {
        azimuths_deg.push_back(azimuth_deg);
        bands.push_back(band);
    }
};

std::vector<DrawnPoint> outlineOf(const Strip& strip, const SkyDisk& disk) {
    std::vector<DrawnPoint> outline;
    const std::size_t count = strip.bands.size();
    for (std::size_t i = 0; i < count; ++i)
        outline.push_back(disk.at({strip.azimuths_deg[i], strip.bands[i].low_deg}));
    for (std::size_t i = count; i-- > 0;)
        outline.push_back(disk.at({strip.azimuths_deg[i], strip.bands[i].high_deg}));
    return outline;
}

/// Follows what is hidden from line to line. What parts or comes together ends there, and begins
/// anew: half a step on either side belongs to each line.
class StripMaking {
public:
    explicit StripMaking(std::size_t lines) : m_half_step_deg(180.0 / static_cast<double>(lines)) {}

    void add(double azimuth_deg, const std::vector<Band>& bands) {
        std::vector<Strip> going_on;
        std::vector<bool> is_taken(m_open.size(), false);
        for (const Band& band : bands) {
            const std::size_t before = soleStripBefore(band, bands);
            if (before < m_open.size()) {
                is_taken[before] = true;
                going_on.push_back(std::move(m_open[before]));
            } else {
                going_on.emplace_back();
                going_on.back().add(azimuth_deg - m_half_step_deg, band);
            }
            going_on.back().add(azimuth_deg, band);
        }
        for (std::size_t i = 0; i < m_open.size(); ++i)
            if (!is_taken[i])
                end(std::move(m_open[i]));
        m_open = std::move(going_on);
    }

    std::vector<Strip> finish() {
        for (Strip& strip : m_open)
            m_ended.push_back(std::move(strip));
        m_open.clear();
        return std::move(m_ended);
    }

private:
    /// The strip that touches this band alone, and that no other strip touches with it.
    std::size_t soleStripBefore(const Band& band, const std::vector<Band>& bands) const {
        std::size_t found = m_open.size();
        for (std::size_t i = 0; i < m_open.size(); ++i) {
            // One that was handed on has no bands any more.
            if (m_open[i].bands.empty() || !doTouch(m_open[i].bands.back(), band))
                continue;
            if (found < m_open.size())
                return m_open.size();
            found = i;
        }
        if (found == m_open.size())
            return found;
        const auto touching = std::ranges::count_if(
            bands, [&](const Band& b) { return doTouch(m_open[found].bands.back(), b); });
        return touching == 1 ? found : m_open.size();
    }

    void end(Strip strip) {
        strip.add(strip.azimuths_deg.back() + m_half_step_deg, Band(strip.bands.back()));
        m_ended.push_back(std::move(strip));
    }

    double m_half_step_deg;
    std::vector<Strip> m_open;
    std::vector<Strip> m_ended;
};

} // namespace

Obstruction obstructionAround(const DisplayScene& scene, const SkyWatch& watch) {
    Looking looking(scene, watch);
    Obstruction found;
    found.lines.resize(LINES);
    for (std::size_t line = 0; line < LINES; ++line)
        found.lines[line] = looking.line(found.azimuthOf(line));
    return found;
}

std::vector<std::vector<DrawnPoint>> hiddenAreas(const Obstruction& obstruction,
                                                 const SkyDisk& disk) {
    const std::size_t count = obstruction.lines.size();
    if (count == 0)
        return {};
    StripMaking making(count);
    for (std::size_t line = 0; line <= count; ++line) // the first one closes the turn
        making.add(obstruction.azimuthOf(line), obstruction.lines[line % count]);
    std::vector<std::vector<DrawnPoint>> areas;
    for (const Strip& strip : making.finish())
        areas.push_back(outlineOf(strip, disk));
    return areas;
}

} // namespace quarn
