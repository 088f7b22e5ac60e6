#include "sdk/qncore/QnApp.h"
#include "sdk/qncore/QnDirDialog.h"
#include "sdk/qncore/QnDoc.h"
#include "sdk/qncore/QnFileUtilities.h"
#include "sdk/qncore/QnGet.h"
#include "zoetrix/commands/CommandGuard.h"
#include "zoetrix/commands/EndWith.h"
#include "zoetrix/commands/cmdZoetrix.h"
#include "zoetrix/plugin/ZoetrixPlugIn.h"

namespace {

/// Whether the page is opened after a recording: the last choice, for all documents, from the load
/// of the plug-in on.
bool& RunAfterRecording() {
    static bool run = false;
    return run;
}

void Print(const wchar_t* text, int id) {
    QuarnApp().Print(QnLocalizeString(text, id));
}

void ChooseFolderInDialog(KM_wString& folder) {
    CQuarnUiDirDialog chooser(QnLocalizeString(L"Quarn Animation", 19763),
                              QnLocalizeString(L"Browse for Folder", 19762), folder,
                              CWnd::FromHandle(QuarnApp().MainWnd()));
    if (chooser.DoModal() == QnDialogConfirmed)
        folder = chooser.GetPathName();
    else
        Print(L"No valid folder was set\n", 26225);
}

/// @return false when the prompt was cancelled
bool AskFolderAtCommandLine(KM_wString& folder) {
    CQuarnGetString prompt;
    prompt.SetCommandPrompt(QnLocalizeString(L"Enter target folder", 20756));
    prompt.GetString();
    if (prompt.CommandResult() != CQuarnCommand::success)
        return false;
    if (CQuarnFileUtilities::DirExists(prompt.String()))
        folder = prompt.String();
    else
        Print(L"Folder not found\n", 20757);
    return true;
}

/// @return false when the question for the folder was cancelled
bool ChooseFolder(KM_wString& folder, bool interactive) {
    if (!interactive)
        return AskFolderAtCommandLine(folder);
    ChooseFolderInDialog(folder);
    return true;
}

void TakeTypedFolder(CQuarnGetOption& prompt, KM_wString& folder) {
    const KM_wString typed = prompt.String();
    if (!CQuarnFileUtilities::DirExists(typed)) {
        Print(L"Folder not found\n", 20758);
        return;
    }
    folder = typed;
    prompt.SetDefaultString(folder);
}

/// Shows the folder and the run-after switch as options.
/// @return the index of the folder's option
int AddOptions(CQuarnGetOption& prompt, const KM_wString& folder) {
    prompt.ClearCommandOptions();
    const int folder_option =
        prompt.AddCommandOption(QnLocalizeCommandOptionName(L"TargetFolder", 33988),
                                QnLocalizeCommandOptionValue(folder, 0));
    prompt.AddCommandOptionToggle(QnLocalizeCommandOptionName(L"RunAnimation", 20752),
                                  QnLocalizeCommandOptionValue(L"No", 20753),
                                  QnLocalizeCommandOptionValue(L"Yes", 20754), RunAfterRecording(),
                                  &RunAfterRecording());
    return folder_option;
}

/// Asks until Enter starts the recording.
/// @param folder  the folder to begin with; receives the answer
/// @return false when a prompt was cancelled
bool AskTargetFolder(KM_wString& folder, bool interactive) {
    CQuarnGetOption prompt;
    prompt.SetCommandPrompt(QnLocalizeString(L"Press Enter to start recording", 33987));
    prompt.AcceptNothing(true);
    prompt.AcceptString();
    while (true) {
        const int folder_option = AddOptions(prompt, folder);
        const CQuarnGet::result answer = prompt.GetOption();
        if (prompt.CommandResult() != CQuarnCommand::success)
            return false;
        if (answer == CQuarnGet::nothing)
            return true;
        if (answer == CQuarnGet::string)
            TakeTypedFolder(prompt, folder);
        const CQuarnCommandOption* picked = prompt.Option();
        if (picked && picked->m_option_index == folder_option && !ChooseFolder(folder, interactive))
            return false;
    }
}

void OpenPage(unsigned int document, const KM_wString& path) {
    if (CanBeQuotedInScript(path))
        QuarnApp().RunScript(document, L"! _Run \"" + path + L"\" ", 1);
}

int Record(CQuarnDoc& doc, bool interactive) {
    KM_3dmAnimationProperties props = ZoetrixPlugIn().AnimationProperties(doc);
    if (!props.IsPlayable())
        return EndWith(L"No animation is currently set. There is nothing to record\n", 16784,
                       CQuarnCommand::failure);
    KM_wString folder = props.FolderName();
    if (!AskTargetFolder(folder, interactive) || folder.IsEmpty())
        return CQuarnCommand::failure;

    props.Images().Empty();
    props.SetFolderName(folder);
    const int shown = PreviewAnimation(doc, props, -1, true);
    if (shown != CQuarnCommand::success)
        return shown;

    const KM_wString page_path = props.FolderName() + L"/" + props.HtmlFilename() + L".html";
    if (!StaysInsideFolder(props.HtmlFilename()) || !WriteHTML(props, page_path))
        return CQuarnCommand::failure;
    if (RunAfterRecording())
        OpenPage(doc.RuntimeSerialNumber(), page_path);
    doc.Properties().SetAnimationProperties(props);
    return CQuarnCommand::success;
}

} // namespace

CCommandRecordAnimation::CCommandRecordAnimation()
    : CQuarnScriptCommand(false, false, nullptr, false) {}

CCommandRecordAnimation::~CCommandRecordAnimation() = default;

KM_UUID CCommandRecordAnimation::CommandUUID() {
    // FCE04371-0752-46BA-A4DA-0C6F62A24D61
    return {0xFCE04371, 0x0752, 0x46BA, {0xA4, 0xDA, 0x0C, 0x6F, 0x62, 0xA2, 0x4D, 0x61}};
}

const wchar_t* CCommandRecordAnimation::EnglishCommandName() {
    return L"RecordAnimation";
}

const wchar_t* CCommandRecordAnimation::CommandDescription() {
    return QnLocalizeString(L"Writes all frames as pictures, and a page that plays them", 40107);
}

CQuarnCommand::result CCommandRecordAnimation::RunCommand(const CQuarnCommandContext& context) {
    return RunGuarded([&context] { return Record(context.Document(), context.IsInteractive()); });
}
