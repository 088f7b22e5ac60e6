#include "host/commands/FormAsking.h"
#include "host/commands/HostCommands.h"
#include "host/commands/PictureSizePrompt.h"
#include "host/commands/RenderSettingsForm.h"
#include "host/document/Document.h"
#include "sdk/qncore/QnGet.h"

#include "engine/render/RenderRequest.h"
namespace quarn {

namespace {

/// Asks for the settings until Enter; nothing changes before.
class SettingsQuestion {
public:
    explicit SettingsQuestion(const RenderSettings& present) : m_wish(present) {}

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
        return m_get.GetOption();
    }

    int addOption(const CQuarnCommandOptionName& name, const KM_wString& value) {
        return m_get.AddCommandOption(name, QnLocalizeCommandOptionValue(value, 0));
    }

    CQuarnCommand::result askPart(int option) {
        if (option == m_size)
            return askPictureSize(m_wish.width_px, m_wish.height_px);
        return askSamples(option == m_samples ? m_wish.samples : m_wish.preview_samples);
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

    RenderSettings m_wish;
    CQuarnGetOption m_get;
    int m_size = 0;
    int m_samples = 0;
    int m_preview_samples = 0;
};

CQuarnCommand::result askSettings(const CQuarnCommandContext& context, RenderSettings& settings) {
    const ViewState& view = Document::of(context.Document()).activeView();
    RenderSettingsForm form(settings, view.frameWidth(), view.frameHeight());
    if (const auto answered = askInForm(context, form)) {
        settings = form.settings;
        return *answered;
    }
    SettingsQuestion question(settings);
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
