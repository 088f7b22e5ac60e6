#include "quarn/scripts/StudyView.h"

#include "quarn/scripts/CameraToFit.h"

#include <algorithm>
#include <array>

namespace quarn::program {

namespace {

/// From the right of a front that looks along the negative Y axis, and high enough to look down on
/// the shadows between the parts of a model.
constexpr double AZIMUTH_DEG = 150.0;
constexpr double ELEVATION_DEG = 30.0;
/// Leaves room on the ground for shadows.
constexpr double DISTANCE_FACTOR = 1.1;

bool isStandardView(const std::string& name) {
    constexpr std::array<std::string_view, 4> NAMES = {"top", "front", "right", "perspective"};
    return std::ranges::find(NAMES, lowerCase(name)) != NAMES.end();
}

/// Reads the options, one after the other, into the commands.
class StudyViewCheck {
public:
    StudyViewCheck(const StudyViewOptions& typed, const std::filesystem::path& model,
                   FirstMistake& mistake)
        : m_typed(typed), m_keeps_camera(isDocument(model) && !aims() && !typed.view),
          m_mistake(mistake), m_azimuth_deg(azimuth()), m_elevation_deg(elevation()),
          m_distance(distance()), m_target(target()) {}

    std::vector<std::string> lines() const {
        if (m_typed.view)
            return namedView(*m_typed.view);
        if (m_keeps_camera)
            return m_distance ? std::vector{fitView(*m_distance)} : std::vector<std::string>();
        // The model's azimuth is a compass's, which runs the other way round from the Y axis.
        return {
            cameraToBeFitted(m_target.value_or(Triple{}), 90.0 - m_azimuth_deg, m_elevation_deg),
            fitView(m_distance.value_or(DISTANCE_FACTOR))};
    }

private:
    bool aims() const { return m_typed.azimuth_deg || m_typed.elevation_deg || m_typed.target; }

    /// @return the fallback where nothing was typed, or a mistake
    double number(const std::optional<std::string>& typed, double low, double high, double fallback,
                  const std::string& mistake) const {
        if (!typed)
            return fallback;
        const std::optional<double> value = realNumber(*typed);
        if (value && *value >= low && *value <= high)
            return *value;
        m_mistake.note(mistake + notBut(*typed));
        return fallback;
    }

    double azimuth() const {
        if (m_typed.view && aims())
            m_mistake.note("--view takes the place of --azimuth, --elevation and --target.");
        return number(m_typed.azimuth_deg, -360.0, 360.0, AZIMUTH_DEG,
                      "--azimuth must be a number of degrees from -360 to 360");
    }

    double elevation() const {
        return number(m_typed.elevation_deg, 0.0, 89.0, ELEVATION_DEG,
                      "--elevation must be a number of degrees from 0 to 89");
    }

    std::optional<double> distance() const {
        const std::optional<double> factor = distanceFactor(m_typed.distance_factor.value_or(""));
        if (m_typed.distance_factor && !factor)
            m_mistake.note("--distance must be a number from 0.01 to 1000" +
                           notBut(*m_typed.distance_factor));
        return factor;
    }

    std::optional<Triple> target() const {
        const std::optional<Triple> point = triple(m_typed.target.value_or(""));
        if (m_typed.target && !point)
            m_mistake.note("--target must be three numbers X,Y,Z without blanks" +
                           notBut(*m_typed.target));
        return point;
    }

    std::string fitView(double distance) const {
        return std::string("_-FitView ") + (m_target ? "_KeepTarget=Yes " : "") + "_Distance " +
               numberText(distance) + " _Enter";
    }

    /// A camera of the model is taken as it is, unless it is to be fitted.
    std::vector<std::string> namedView(const std::string& name) const {
        m_mistake.note(whyPathIsRefused("the name of --view", name));
        std::vector<std::string> lines = {"_-StandardView \"" + name + "\""};
        if (isStandardView(name) || m_distance)
            lines.push_back(fitView(m_distance.value_or(DISTANCE_FACTOR)));
        return lines;
    }

    const StudyViewOptions& m_typed;
    const bool m_keeps_camera;
    FirstMistake& m_mistake;
    const double m_azimuth_deg;
    const double m_elevation_deg;
    const std::optional<double> m_distance;
    const std::optional<Triple> m_target;
};

} // namespace

std::vector<std::string> studyViewLines(const StudyViewOptions& options,
                                        const std::filesystem::path& model, FirstMistake& mistake) {
    return StudyViewCheck(options, model, mistake).lines();
}

} // namespace quarn::program
