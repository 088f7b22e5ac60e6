#include "engine/render/RenderRequest.h"
#include "host/commands/ColorText.h"
#include "host/commands/FormAsking.h"
#include "host/commands/HostCommands.h"
#include "host/commands/LightPrompt.h"
#include "host/commands/LightWords.h"
#include "host/commands/PictureSizePrompt.h"
#include "host/commands/RenderSettingsForm.h"
#include "host/document/Document.h"
#include "host/document/DocumentDrawing.h"
#include "host/prompt/NumberText.h"
#include "sdk/qncore/QnGet.h"

namespace quarn {

namespace {

/// Asks for the settings until Enter; nothing changes before.
class SettingsQuestion {
public:
    SettingsQuestion(const CQuarnCommandContext& context, DocumentDrawing& drawing,
                     const RenderSettings& present)
        : m_context(context), m_drawing(drawing), m_wish(present) {}

    CQuarnCommand::result run() {
        for (;;) {
            const CQuarnGet::result answer = ask();
            if (answer == CQuarnGet::nothing)
                return CQuarnCommand::success;
            if (answer == CQuarnGet::string)
                return CQuarnCommand::failure;
            if (answer != CQuarnGet::option)
                return m_get.CommandResult();
            const CQuarnCommand::result asked = askPart(m_get.Option()->m_option_index);
            if (asked != CQuarnCommand::success)
                return asked;
        }
    }

    const RenderSettings& wish() const { return m_wish; }

private:
    CQuarnGet::result ask() {
        const auto number = [](int value) { return KM_wString::FormatToString(L"%d", value); };
        m_get.SetCommandPrompt(QnLocalizeString(L"Render settings, Enter to keep them", 42360));
        m_get.AcceptNothing(true);
        m_get.ClearCommandOptions();
        m_size = addOption(QnLocalizeCommandOptionName(L"Size", 42350),
                           number(m_wish.width_px) + L"x" + number(m_wish.height_px));
        m_samples =
            addOption(QnLocalizeCommandOptionName(L"Samples", 42351), number(m_wish.samples));
        m_preview_samples = addOption(QnLocalizeCommandOptionName(L"PreviewSamples", 42352),
                                      number(m_wish.preview_samples));
        addLightOptions();
        return m_get.GetOption();
    }

    void addLightOptions() {
        const LightChoice& light = m_wish.light;
        m_light = addOption(QnLocalizeCommandOptionName(L"Light", 42926),
                            lightWord(light.surroundings).option().m_local);
        m_exposure = addOption(QnLocalizeCommandOptionName(L"Exposure", 42927),
                               light.exposure ? numberText(*light.exposure)
                                              : AUTOMATIC_WORD.option().m_local);
        m_background = addOption(QnLocalizeCommandOptionName(L"Background", 42928),
                                 light.background == BackgroundKind::color
                                     ? colorText(light.background_color)
                                     : lightWord(light.background).option().m_local);
        m_get.AddCommandOptionToggle(QnLocalizeCommandOptionName(L"Ground", 42929),
                                     QnLocalizeCommandOptionValue(L"No", 42001),
                                     QnLocalizeCommandOptionValue(L"Yes", 42002), light.has_ground,
                                     &m_wish.light.has_ground);
    }

    int addOption(const CQuarnCommandOptionName& name, const KM_wString& value) {
        return m_get.AddCommandOption(name, QnLocalizeCommandOptionValue(value, 0));
    }

    CQuarnCommand::result askPart(int option) {
        if (option == m_size)
            return askPictureSize(m_wish.width_px, m_wish.height_px);
        if (option == m_samples)
            return askSamples(m_wish.samples);
        if (option == m_preview_samples)
            return askSamples(m_wish.preview_samples);
        if (option == m_light)
            return askSurroundings(m_context, m_drawing, m_wish.light);
        if (option == m_exposure)
            return askExposure(m_wish.light);
        if (option == m_background)
            return askBackground(m_wish.light);
        return CQuarnCommand::success; // the ground, which is toggled
    }

    static CQuarnCommand::result askSamples(int& samples) {
        CQuarnGetInteger get;
        get.SetCommandPrompt(QnLocalizeString(L"Samples of each pixel", 42361));
        get.SetDefaultInteger(samples);
        get.SetLowerLimit(1);
        get.SetUpperLimit(RenderRequest::most_samples);
        if (get.GetNumber() == CQuarnGet::number)
            samples = get.Number();
        return get.CommandResult();
    }

    const CQuarnCommandContext& m_context;
    DocumentDrawing& m_drawing;
    RenderSettings m_wish;
    CQuarnGetOption m_get;
    int m_size = 0;
    int m_samples = 0;
    int m_preview_samples = 0;
    int m_light = 0;
    int m_exposure = 0;
    int m_background = 0;
};

/// A picture that the form reads is kept by the document, which draws with it next.
RenderSettingsSources sourcesFor(const CQuarnCommandContext& context, Document& document) {
    const ViewState& view = document.activeView();
    RenderSettingsSources sources;
    sources.view_width_px = view.frameWidth();
    sources.view_height_px = view.frameHeight();
    sources.choose_picture = [&context](const std::filesystem::path& present) {
        return chooseSurroundings(context, present);
    };
    sources.read_picture = [&document](const std::filesystem::path& file) {
        return document.drawing().light().readSurroundings(surroundingsFile(document, file));
    };
    return sources;
}

CQuarnCommand::result askSettings(const CQuarnCommandContext& context, RenderSettings& settings) {
    Document& document = Document::of(context.Document());
    RenderSettingsForm form(settings, sourcesFor(context, document));
    if (const auto answered = askInForm(context, form)) {
        settings = form.settings;
        return *answered;
    }
    SettingsQuestion question(context, document.drawing(), settings);
    const CQuarnCommand::result asked = question.run();
    settings = question.wish();
    return asked;
}

} // namespace

CQuarnCommand::result runRenderSettings(const CQuarnCommandContext& context) {
    RenderSettings& settings = Document::of(context.Document()).renderWindow().settings;
    RenderSettings wish = settings;
    const CQuarnCommand::result asked = askSettings(context, wish);
    if (asked == CQuarnCommand::success)
        settings = wish;
    return asked;
}

} // namespace quarn
