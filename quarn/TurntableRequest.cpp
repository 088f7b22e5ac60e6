#include "quarn/TurntableRequest.h"

#include "quarn/AnimationName.h"
#include "quarn/CaptureMode.h"

#include <algorithm>
#include <cmath>

namespace quarn::program {

namespace {

constexpr double STEEPEST_ELEVATION_DEG = 89.0;
constexpr double NEAREST_DISTANCE = 0.01; // as the command FitView takes them
constexpr double FARTHEST_DISTANCE = 1000.0;

std::string notBut(const std::string& word) {
    return ", not \"" + word + "\".";
}

/// Reads one option after the other and keeps the first mistake.
class TurntableCheck {
public:
    explicit TurntableCheck(const TurntableOptions& options) : m_typed(options) {}

    std::variant<TurntableRequest, Outcome> run() {
        checkPaths();
        checkUpAxis();
        checkName();
        checkFrames();
        checkSize();
        checkMode();
        checkFormat();
        checkDirection();
        checkCamera();
        checkHidden();
        checkDocument();
        if (m_mistake)
            return Outcome::misuse(*m_mistake);
        return m_request;
    }

private:
    void refuse(std::optional<std::string> mistake) {
        if (!m_mistake)
            m_mistake = std::move(mistake);
    }

    void checkPaths() {
        m_request.model = m_typed.model;
        m_request.folder = m_typed.folder;
        refuse(whyPathIsRefused("the model's path", m_request.model));
        refuse(whyPathIsRefused("the path of --out", m_request.folder));
    }

    void checkUpAxis() {
        const std::string axis = lowerCase(m_typed.up_axis);
        m_request.up_axis = axis == "y" ? "Y" : axis == "z" ? "Z" : "";
        if (!axis.empty() && m_request.up_axis.empty())
            refuse("--up must be y or z" + notBut(m_typed.up_axis));
        if (!axis.empty() && isDocument(m_request.model))
            refuse("--up is for model files; a document knows its axes.");
    }

    void checkName() {
        if (m_typed.was_name_given)
            refuse(whyNameIsRefused(m_typed.name));
        m_request.name = m_typed.was_name_given ? m_typed.name : animationNameFor(m_request.model);
    }

    void checkFrames() {
        m_request.frames = wholeNumber(m_typed.frames).value_or(0);
        if (m_request.frames < 1)
            refuse("--frames must be a whole number from 1" + notBut(m_typed.frames));
    }

    void checkSize() {
        m_request.size = pictureSize(m_typed.size).value_or(PixelSize{0, 0});
        if (m_request.size.width_px == 0)
            refuse(sizeMistake(m_typed.size));
    }

    void checkMode() {
        const std::optional<std::string> option = captureOption(m_typed.mode);
        if (!option)
            refuse("unknown display mode \"" + m_typed.mode + "\"; --mode takes " +
                   captureModeNames() + ".");
        m_request.capture_option = option.value_or("");
    }

    void checkFormat() {
        constexpr std::array<std::string_view, 4> FORMATS = {"jpg", "png", "bmp", "tga"};
        m_request.format = lowerCase(m_typed.format);
        if (std::find(FORMATS.begin(), FORMATS.end(), m_request.format) == FORMATS.end())
            refuse("--format must be jpg, png, bmp or tga" + notBut(m_typed.format));
    }

    void checkDirection() {
        const std::string direction = lowerCase(m_typed.direction);
        m_request.is_clockwise = direction == "clockwise";
        if (!m_request.is_clockwise && direction != "anticlockwise")
            refuse("--direction must be clockwise or anticlockwise" + notBut(m_typed.direction));
    }

    void checkCamera() {
        const std::optional<double> elevation = realNumber(m_typed.elevation_deg);
        if (!elevation || std::abs(*elevation) > STEEPEST_ELEVATION_DEG)
            refuse("--elevation must be a number of degrees from -89 to 89" +
                   notBut(m_typed.elevation_deg));
        m_request.elevation_deg = elevation.value_or(0.0);
        m_request.distance_factor = realNumber(m_typed.distance_factor);
        const double factor = m_request.distance_factor.value_or(0.0);
        if (!m_typed.distance_factor.empty() &&
            (factor < NEAREST_DISTANCE || factor > FARTHEST_DISTANCE))
            refuse("--distance must be a number from 0.01 to 1000" +
                   notBut(m_typed.distance_factor));
        m_request.target = triple(m_typed.target);
        if (!m_typed.target.empty() && !m_request.target)
            refuse("--target must be three numbers X,Y,Z without blanks" + notBut(m_typed.target));
    }

    void checkHidden() {
        m_request.hidden = m_typed.hidden;
        for (const std::string& name : m_request.hidden)
            refuse(whyPathIsRefused("the name of --hide", name));
    }

    void checkDocument() {
        if (!m_typed.was_document_given)
            return;
        m_request.document = m_typed.document;
        refuse(whyPathIsRefused("the path of --save", m_request.document));
        if (!m_request.document.has_filename())
            refuse("--save must name a file" + notBut(m_typed.document));
        if (!m_request.document.has_extension())
            m_request.document += ".quarn";
        if (!isDocument(m_request.document))
            refuse("--save must name a file that ends in .quarn" + notBut(m_typed.document));
    }

    const TurntableOptions& m_typed;
    TurntableRequest m_request{};
    std::optional<std::string> m_mistake;
};

} // namespace

std::variant<TurntableRequest, Outcome> checkTurntable(const TurntableOptions& options) {
    return TurntableCheck(options).run();
}

std::filesystem::path pagePath(const TurntableRequest& request) {
    return request.folder / (request.name + ".html");
}

} // namespace quarn::program
