#include "host/app/RecordNames.h"

#include "host/document/Document.h"
#include "sdk/qncore/QnAnimationName.h"

#include <algorithm>

namespace quarn {

namespace {

bool isForbiddenInNames(wchar_t character) {
    return QnIsForbiddenInNames(character) || QnIsControlCharacter(character);
}

bool isForbiddenInLabels(wchar_t character) {
    constexpr std::wstring_view of_pages_and_scripts = L"\"\\<>";
    return of_pages_and_scripts.find(character) != std::wstring_view::npos ||
           QnIsControlCharacter(character);
}

using Rule = bool (*)(wchar_t);

/// The text with "_" in place of each character that the rule forbids; as it was where none is.
KM_wString cleaned(const KM_wString& text, Rule is_forbidden) {
    std::wstring characters(text.View());
    std::ranges::replace_if(characters, is_forbidden, L'_');
    return KM_wString(characters);
}

bool isClean(const KM_wString& text, Rule is_forbidden) {
    return std::ranges::none_of(text.View(), is_forbidden);
}

bool clean(KM_ClassArray<KM_wString>& texts, Rule is_forbidden) {
    bool has_changed = false;
    for (int index = 0; index < texts.Count(); ++index) {
        if (isClean(texts[index], is_forbidden))
            continue;
        texts[index] = cleaned(texts[index], is_forbidden);
        has_changed = true;
    }
    return has_changed;
}

bool clean(KM_3dmAnimationProperties& record) {
    const bool are_clean = isClean(record.HtmlFilename(), isForbiddenInNames) &&
                           isClean(record.FileExtension(), isForbiddenInNames);
    record.SetHtmlFilename(cleaned(record.HtmlFilename(), isForbiddenInNames));
    record.SetFileExtension(cleaned(record.FileExtension(), isForbiddenInNames));
    const bool images_changed = clean(record.Images(), isForbiddenInNames);
    const bool dates_changed = clean(record.Dates(), isForbiddenInLabels);
    return !are_clean || images_changed || dates_changed;
}

} // namespace

bool cleanRecordNames(Document& document) {
    KM_3dmAnimationProperties record = document.properties().AnimationProperties();
    if (!clean(record))
        return false;
    document.properties().SetAnimationProperties(record);
    return true;
}

} // namespace quarn
