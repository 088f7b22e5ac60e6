#include "sdk/qncore/QnAnimationName.h"
#include "sdk/qncore/QnApp.h"
#include "sdk/qncore/QnDoc.h"
#include "sdk/qncore/QnView.h"
#include "zoetrix/commands/cmdZoetrix.h"
#include "zoetrix/plugin/ZoetrixUtilities.h"

#include <algorithm>

namespace {

bool IsLineBreak(wchar_t character) {
    return (character >= L'\n' && character <= L'\r') || character == L'\u0085' ||
           character == L'\u2028' || character == L'\u2029';
}

KM_SimpleArray<CQuarnView*> ViewsOf(const CQuarnDoc& doc) {
    KM_SimpleArray<CQuarnView*> views;
    doc.GetViewList(views, true, true);
    return views;
}

bool HasName(const CQuarnView& view, const KM_wString& name, bool ignore_case) {
    const wchar_t* view_name = view.MainViewport().Name();
    return ignore_case ? name.CompareNoCase(view_name) == 0 : name == view_name;
}

} // namespace

bool GetViewList(KM_ClassArray<KM_wString>& names) {
    const CQuarnDoc* doc = QuarnApp().ActiveDoc();
    if (!doc)
        return true;
    for (const CQuarnView* view : ViewsOf(*doc)) {
        if (view)
            names.Append(view->MainViewport().Name());
    }
    return true;
}

CQuarnView* CZoetrixUtilities::FindQuarnViewByName(CQuarnDoc& doc, const KM_wString& name,
                                                   bool ignore_case) {
    for (CQuarnView* view : ViewsOf(doc)) {
        if (view && HasName(*view, name, ignore_case))
            return view;
    }
    return nullptr;
}

void CleanExtention(KM_wString& ext) {
    ext.Remove(L'.');
}

bool IsValidFileName(KM_wString name) {
    if (name.IsEmpty() || name.Length() > QnLongestAnimationName)
        return false;
    return std::ranges::none_of(name.View(), QnIsForbiddenInNames);
}

int ReplaceInvalidFileChar(KM_wString& name) {
    int replaced = 0;
    for (const wchar_t character : QnForbiddenInNames)
        replaced += name.Replace(character, L'_');
    return replaced;
}

bool StaysInsideFolder(const KM_wString& name) {
    return std::ranges::none_of(name.View(), [](wchar_t character) {
        return character == L'/' || character == L'\\' || QnIsControlCharacter(character);
    });
}

bool CanBeQuotedInScript(const KM_wString& path) {
    return std::ranges::none_of(
        path.View(), [](wchar_t character) { return character == L'"' || IsLineBreak(character); });
}
