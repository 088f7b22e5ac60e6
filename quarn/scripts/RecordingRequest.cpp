#include "quarn/scripts/RecordingRequest.h"

#include "quarn/words/AnimationName.h"

#include <algorithm>
#include <array>

namespace quarn::program {

namespace {

/// Reads one option after the other.
class RecordingCheck {
public:
    RecordingCheck(const RecordingOptions& options, FirstMistake& mistake, CaptureSubject subject)
        : m_typed(options), m_mistake(mistake), m_subject(subject) {}

    RecordingRequest run() {
        checkPaths();
        checkUpAxis();
        checkName();
        checkSize();
        checkMode();
        checkSamples();
        checkFormat();
        checkHidden();
        checkDocument();
        return m_request;
    }

private:
    void checkPaths() {
        m_request.model = m_typed.model;
        m_request.folder = m_typed.folder;
        m_mistake.note(whyPathIsRefused("the model's path", m_request.model));
        m_mistake.note(whyPathIsRefused("the path of --out", m_request.folder));
    }

    void checkUpAxis() {
        const std::string axis = lowerCase(m_typed.up_axis);
        m_request.up_axis = axis == "y" ? "Y" : axis == "z" ? "Z" : "";
        if (!axis.empty() && m_request.up_axis.empty())
            m_mistake.note("--up must be y or z" + notBut(m_typed.up_axis));
        if (!axis.empty() && isDocument(m_request.model))
            m_mistake.note("--up is for model files; a document knows its axes.");
    }

    void checkName() {
        if (m_typed.was_name_given)
            m_mistake.note(whyNameIsRefused(m_typed.name));
        m_request.name = m_typed.was_name_given ? m_typed.name : animationNameFor(m_request.model);
    }

    void checkSize() {
        m_request.size = pictureSize(m_typed.size).value_or(PixelSize{0, 0});
        if (m_request.size.width_px == 0)
            m_mistake.note(sizeMistake(m_typed.size));
    }

    void checkMode() {
        const std::optional<std::string> option = captureOption(m_typed.mode);
        if (!option)
            m_mistake.note("unknown display mode \"" + m_typed.mode + "\"; --mode takes " +
                           captureModeNames(m_subject) + ".");
        else if (m_subject == CaptureSubject::moving_sun && !suitsSunStudies(*option))
            m_mistake.note("sun studies are not recorded in the display mode \"" + m_typed.mode +
                           "\"; --mode takes " + captureModeNames(m_subject) + ".");
        m_request.capture_option = option.value_or("");
    }

    void checkSamples() {
        constexpr int MOST_SAMPLES = 16384;
        if (m_typed.samples.empty())
            return;
        m_request.samples = wholeNumber(m_typed.samples).value_or(0);
        if (m_request.samples < 1 || m_request.samples > MOST_SAMPLES)
            m_mistake.note("--samples must be a whole number from 1 to " +
                           std::to_string(MOST_SAMPLES) + notBut(m_typed.samples));
        if (!isRendered(m_request.capture_option))
            m_mistake.note(
                "--samples is for rendered pictures: with it --mode must be RenderFull or "
                "RenderPreview" +
                notBut(m_typed.mode));
    }

    void checkFormat() {
        constexpr std::array<std::string_view, 4> FORMATS = {"jpg", "png", "bmp", "tga"};
        m_request.format = lowerCase(m_typed.format);
        if (std::find(FORMATS.begin(), FORMATS.end(), m_request.format) == FORMATS.end())
            m_mistake.note("--format must be jpg, png, bmp or tga" + notBut(m_typed.format));
    }

    void checkHidden() {
        m_request.hidden = m_typed.hidden;
        for (const std::string& name : m_request.hidden)
            m_mistake.note(whyPathIsRefused("the name of --hide", name));
    }

    void checkDocument() {
        if (!m_typed.was_document_given)
            return;
        m_request.document = m_typed.document;
        m_mistake.note(whyPathIsRefused("the path of --save", m_request.document));
        if (!m_request.document.has_filename())
            m_mistake.note("--save must name a file" + notBut(m_typed.document));
        if (!m_request.document.has_extension())
            m_request.document += ".quarn";
        if (!isDocument(m_request.document))
            m_mistake.note("--save must name a file that ends in .quarn" +
                           notBut(m_typed.document));
    }

    const RecordingOptions& m_typed;
    FirstMistake& m_mistake;
    const CaptureSubject m_subject;
    RecordingRequest m_request{};
};

} // namespace

RecordingRequest checkRecording(const RecordingOptions& options, FirstMistake& mistake,
                                CaptureSubject subject) {
    return RecordingCheck(options, mistake, subject).run();
}

int checkFrames(const std::string& frames, FirstMistake& mistake) {
    const int count = wholeNumber(frames).value_or(0);
    if (count < 1)
        mistake.note("--frames must be a whole number from 1" + notBut(frames));
    return count;
}

std::filesystem::path pagePath(const RecordingRequest& request) {
    return request.folder / (request.name + ".html");
}

} // namespace quarn::program
