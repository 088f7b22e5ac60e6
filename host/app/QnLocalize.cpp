#include "sdk/qncore/QnLocalize.h"

#include "host/app/Application.h"

namespace {

const wchar_t* localText(quarn::TextSpace space, const wchar_t* english, int id) {
    quarn::Application* application = quarn::Application::current();
    const wchar_t* local = application && id != 0 ? application->texts().find(space, id) : nullptr;
    return local ? local : english;
}

} // namespace

const wchar_t* QnLocalizeString(const wchar_t* english, int id) {
    return localText(quarn::TextSpace::strings, english, id);
}

CQuarnCommandOptionName QnLocalizeCommandOptionName(const wchar_t* english, int id) {
    return {english, localText(quarn::TextSpace::option_names, english, id)};
}

CQuarnCommandOptionValue QnLocalizeCommandOptionValue(const wchar_t* english, int id) {
    return {english, localText(quarn::TextSpace::option_values, english, id)};
}
