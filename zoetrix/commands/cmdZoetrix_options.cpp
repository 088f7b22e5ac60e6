#include "sdk/qncore/QnApp.h"
#include "sdk/qncore/QnDoc.h"
#include "sdk/qncore/QnGet.h"
#include "sdk/qncore/QnView.h"
#include "zoetrix/commands/DisplayModeChoices.h"
#include "zoetrix/commands/EndWith.h"
#include "zoetrix/commands/cmdZoetrix.h"
#include "zoetrix/plugin/ZoetrixUtilities.h"

#include <algorithm>
#include <iterator>
#include <vector>

namespace {

struct FileType {
    const wchar_t* extension;
    int option_name_id;
};

constexpr FileType file_types[] = {
    {L"jpg", 18433}, {L"bmp", 18434}, {L"png", 18435}, {L"tga", 18436}};

int AskFileType(KM_3dmAnimationProperties& props) {
    KM_wString extension = props.FileExtension();
    CQuarnGetOption prompt;
    prompt.SetCommandPrompt(QnLocalizeString(L"File type", 16714));
    prompt.SetDefaultString(extension);
    prompt.AcceptNothing(true);
    int options[std::size(file_types)];
    std::ranges::transform(file_types, options, [&prompt](const FileType& type) {
        return prompt.AddCommandOption(
            QnLocalizeCommandOptionName(type.extension, type.option_name_id));
    });

    prompt.GetOption();
    if (prompt.CommandResult() != CQuarnCommand::success)
        return EndWith(L"Failed to select file type. Nothing done\n", 16715,
                       prompt.CommandResult());
    if (const CQuarnCommandOption* picked = prompt.Option()) {
        const auto* found = std::ranges::find(options, picked->m_option_index);
        if (found != std::end(options))
            extension = file_types[found - options].extension;
    }
    props.SetFileExtension(extension);
    return CQuarnCommand::success;
}

void ChooseFullRender(KM_3dmAnimationProperties& props) {
    props.SetCaptureMethod(QnLocalizeString(L"RenderFull", 19750));
    props.SetRenderFull(true);
    props.SetRenderPreview(false);
}

void ChoosePreviewRender(KM_3dmAnimationProperties& props) {
    props.SetCaptureMethod(QnLocalizeString(L"RenderPreview", 19751));
    props.SetRenderFull(false);
    props.SetRenderPreview(true);
}

void ChooseDisplayMode(KM_3dmAnimationProperties& props, const DisplayModeChoice& mode) {
    props.SetCaptureMethod(mode.local_name);
    props.SetDisplayMode(mode.id);
    props.SetRenderFull(false);
    props.SetRenderPreview(false);
}

/// Leaves the record with a capture method that the prompt can offer. Only the name changes: Enter
/// at the prompt then keeps display mode and render flags as they are.
/// @return false when there is none to offer
bool NormaliseCaptureMethod(KM_3dmAnimationProperties& props,
                            const std::vector<DisplayModeChoice>& modes) {
    const KM_wString method = props.CaptureMethod();
    const auto is_method = [&method](const wchar_t* name) {
        return method.CompareNoCase(name) == 0;
    };
    if (is_method(QnLocalizeString(L"RenderFull", 19748)) ||
        is_method(QnLocalizeString(L"RenderPreview", 19749)) ||
        std::ranges::any_of(modes, is_method, &DisplayModeChoice::local_name))
        return true;
    if (modes.empty())
        return false;
    props.SetCaptureMethod(modes.front().local_name);
    return true;
}

/// Takes a capture method in the form that scripts type: an English name behind an underscore.
/// Other text keeps the method there is.
/// @return false for a name of that form that is unknown
bool TakeTypedCaptureMethod(KM_3dmAnimationProperties& props, KM_wString text,
                            const std::vector<DisplayModeChoice>& modes) {
    if (text[0] != L'_')
        return true;
    text.Remove(L'_');
    if (text.CompareNoCase(L"RenderFull") == 0) {
        ChooseFullRender(props);
        return true;
    }
    if (text.CompareNoCase(L"RenderPreview") == 0) {
        ChoosePreviewRender(props);
        return true;
    }
    const auto mode = std::ranges::find_if(modes, [&text](const DisplayModeChoice& choice) {
        return text.CompareNoCase(choice.english_name) == 0;
    });
    if (mode == modes.end())
        return false;
    ChooseDisplayMode(props, *mode);
    return true;
}

/// The indices of the capture method prompt's options.
struct CaptureMethodOptions {
    int full;
    int preview;
    std::vector<int> modes; ///< in the order of the display modes
};

CaptureMethodOptions AddCaptureMethodOptions(CQuarnGetString& prompt,
                                             const std::vector<DisplayModeChoice>& modes) {
    CaptureMethodOptions options;
    options.full = prompt.AddCommandOption(QnLocalizeCommandOptionName(L"RenderFull", 18437));
    options.preview = prompt.AddCommandOption(QnLocalizeCommandOptionName(L"RenderPreview", 18438));
    for (const DisplayModeChoice& mode : modes)
        options.modes.push_back(
            prompt.AddCommandOption(QnLocalizeCommandOptionName(mode.local_name, 0)));
    return options;
}

void TakePickedCaptureMethod(KM_3dmAnimationProperties& props, int picked,
                             const CaptureMethodOptions& options,
                             const std::vector<DisplayModeChoice>& modes) {
    if (picked == options.full)
        return ChooseFullRender(props);
    if (picked == options.preview)
        return ChoosePreviewRender(props);
    const auto found = std::ranges::find(options.modes, picked);
    if (found != options.modes.end())
        ChooseDisplayMode(props, modes[static_cast<std::size_t>(found - options.modes.begin())]);
}

int AskCaptureMethod(KM_3dmAnimationProperties& props, bool sun_filter) {
    const std::vector<DisplayModeChoice> modes = ListDisplayModes(sun_filter);
    if (!NormaliseCaptureMethod(props, modes))
        return CQuarnCommand::failure;

    CQuarnGetString prompt;
    prompt.ClearCommandOptions();
    prompt.SetCommandPrompt(QnLocalizeString(L"Frame capture method", 16716));
    prompt.SetDefaultString(props.CaptureMethod());
    prompt.AcceptNothing(true);
    const CaptureMethodOptions options = AddCaptureMethodOptions(prompt, modes);
    const CQuarnGet::result answer = prompt.GetString();
    if (prompt.CommandResult() != CQuarnCommand::success)
        return EndWith(L"Failed to select capture method. Nothing done\n", 16717,
                       prompt.CommandResult());
    if (answer == CQuarnGet::string && !TakeTypedCaptureMethod(props, prompt.String(), modes))
        return CQuarnCommand::failure;
    if (const CQuarnCommandOption* picked = prompt.Option())
        TakePickedCaptureMethod(props, picked->m_option_index, options, modes);
    return CQuarnCommand::success;
}

KM_wString ActiveViewName() {
    const CQuarnView* view = QuarnApp().ActiveView();
    return view ? view->MainViewport().Name() : L"";
}

int AskViewport(KM_3dmAnimationProperties& props) {
    CQuarnGetString prompt;
    prompt.SetCommandPrompt(QnLocalizeString(L"Viewport name to render", 16718));
    prompt.AcceptNothing(true);
    prompt.SetDefaultString(ActiveViewName());
    prompt.GetString();
    if (prompt.CommandResult() != CQuarnCommand::success)
        return EndWith(L"Invalid name. Nothing done\n", 16719, prompt.CommandResult());

    KM_wString name = prompt.String();
    name.TrimLeftAndRight();
    if (name.IsEmpty())
        return EndWith(L"Invalid viewport name. Nothing done\n", 16720, CQuarnCommand::failure);
    CQuarnDoc* active_doc = QuarnApp().ActiveDoc();
    if (!active_doc || !CZoetrixUtilities::FindQuarnViewByName(*active_doc, name, true))
        return EndWith(L"Invalid viewport name. Nothing done\n", 16721, CQuarnCommand::failure);
    props.SetViewportName(name);
    return CQuarnCommand::success;
}

/// Asks for the sequence name and keeps the record's whatever the answer is.
int AskSequenceName(const KM_3dmAnimationProperties& props) {
    CQuarnGetString prompt;
    prompt.SetCommandPrompt(QnLocalizeString(L"Animation sequence name", 16722));
    prompt.SetDefaultString(props.HtmlFilename());
    prompt.GetString();
    if (prompt.CommandResult() != CQuarnCommand::success)
        return EndWith(L"Invalid name. Nothing done\n", 16723, prompt.CommandResult());
    return CQuarnCommand::success;
}

int IndexOrFirst(const KM_ClassArray<KM_wString>& list, const KM_wString& entry) {
    return std::max(list.Search(entry), 0);
}

} // namespace

int GetAnimationOptions(CQuarnDoc&, KM_3dmAnimationProperties& props, bool sunFilter) {
    if (const int ended = AskFileType(props); ended != CQuarnCommand::success)
        return ended;
    if (const int ended = AskCaptureMethod(props, sunFilter); ended != CQuarnCommand::success)
        return ended;
    if (const int ended = AskViewport(props); ended != CQuarnCommand::success)
        return ended;
    return AskSequenceName(props);
}

bool GetDailogAnimationOptions(KM_3dmAnimationProperties& props,
                               KM_ClassArray<KM_wString>& fileTypes, int& fileTypeIndex,
                               KM_ClassArray<KM_wString>& captureMethods, int& captureIndex,
                               KM_ClassArray<KM_wString>& viewNames, int& viewIndex,
                               KM_SimpleArray<KM_UUID>& displayModeIds, bool sunFilter) {
    fileTypes.Empty();
    for (const FileType& type : file_types)
        fileTypes.Append(type.extension);
    fileTypeIndex = IndexOrFirst(fileTypes, props.FileExtension());

    captureMethods.Empty();
    captureMethods.Append(QnLocalizeString(L"RenderFull", 20762));
    captureMethods.Append(QnLocalizeString(L"RenderPreview", 20763));
    displayModeIds.Empty();
    for (const DisplayModeChoice& mode : ListDisplayModes(sunFilter)) {
        captureMethods.Append(mode.local_name);
        displayModeIds.Append(mode.id);
    }
    captureIndex = IndexOrFirst(captureMethods, props.CaptureMethod());

    viewNames.Empty();
    GetViewList(viewNames);
    viewIndex = IndexOrFirst(viewNames, props.ViewportName());
    return true;
}
