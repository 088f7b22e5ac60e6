#include "host/commands/CommandEnd.h"
#include "host/commands/HostCommands.h"
#include "host/document/Document.h"
#include "sdk/qncore/QnAnimationName.h"
#include "sdk/qncore/QnGet.h"
#include "sdk/qncore/QnZoetrixDynamicAccess.h"

#include <algorithm>

namespace quarn {

namespace {

bool isForbidden(wchar_t character) {
    return QnIsControlCharacter(character) || QnIsForbiddenInNames(character);
}

bool isFolderName(std::wstring_view name) {
    return name == L"." || name == L"..";
}

/// Why pictures and a page cannot be called so; empty when they can.
std::string whyRefused(const KM_wString& name) {
    KM_wString trimmed = name;
    trimmed.TrimLeftAndRight();
    const std::wstring_view text = name.View();
    if (trimmed.IsEmpty())
        return "The name of an animation cannot be empty.";
    if (name.Length() > QnLongestAnimationName)
        return "The name of an animation has at most " + std::to_string(QnLongestAnimationName) +
               " characters, not " + std::to_string(name.Length()) + ".";
    if (std::any_of(text.begin(), text.end(), isForbidden))
        return "The name of an animation becomes part of file names: it cannot hold "
               "\\ | / : * ? \" < > or control characters.";
    if (isFolderName(trimmed.View()))
        return "\"" + name.ToUtf8() + "\" names a folder; give the animation another name.";
    return {};
}

} // namespace

CQuarnCommand::result runAnimationName(const CQuarnCommandContext& context) {
    if (!Zoetrix_QuarnDynamicAccess())
        return fail("No plug-in keeps an animation. Load one with LoadPlugIn first.");
    CQuarnDocProperties& properties = context.Document().Properties();
    KM_3dmAnimationProperties record = properties.AnimationProperties();
    CQuarnGetString get;
    get.SetCommandPrompt(QnLocalizeString(L"Name of the animation", 42040));
    get.SetDefaultString(record.HtmlFilename());
    if (get.GetString() != CQuarnGet::string)
        return get.CommandResult();
    const KM_wString name = get.String();
    if (const std::string reason = whyRefused(name); !reason.empty())
        return fail(reason);
    record.SetHtmlFilename(name);
    properties.SetAnimationProperties(record);
    return CQuarnCommand::success;
}

} // namespace quarn
