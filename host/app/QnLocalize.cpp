#include "sdk/qncore/QnLocalize.h"

#include "host/app/Application.h"
#include "host/app/FormatArguments.h"

namespace {

/// A table may come from anywhere. One that asks for other arguments than the caller hands over
/// would read what is none.
bool canStandFor(const wchar_t* local, const wchar_t* english) {
    return quarn::formatArguments(local) == quarn::formatArguments(english);
}

const wchar_t* localText(const char* call, quarn::TextSpace space, const wchar_t* english, int id) {
    quarn::Application* application = quarn::Application::forCall(call);
    const wchar_t* local = application && id != 0 ? application->texts().find(space, id) : nullptr;
    return local && canStandFor(local, english) ? local : english;
}

} // namespace

const wchar_t* QnLocalizeString(const wchar_t* english, int id) {
    return localText("QnLocalizeString", quarn::TextSpace::strings, english, id);
}

CQuarnCommandOptionName QnLocalizeCommandOptionName(const wchar_t* english, int id) {
    return {english,
            localText("QnLocalizeCommandOptionName", quarn::TextSpace::option_names, english, id)};
}

CQuarnCommandOptionValue QnLocalizeCommandOptionValue(const wchar_t* english, int id) {
    return {english, localText("QnLocalizeCommandOptionValue", quarn::TextSpace::option_values,
                               english, id)};
}
