#include "host/commands/UpAxisText.h"

#include "sdk/qncore/QnLocalize.h"

namespace quarn {

std::string upAxisText(const TakenUpAxis& up) {
    using Reason = TakenUpAxis::Reason;
    const wchar_t* const axis = up.axis == UpAxis::y ? L"Y" : L"Z";
    if (up.reason == Reason::habit)
        return KM_wString::FormatToString(
                   QnLocalizeString(L"%s is taken as up, as in most files of this kind; the option "
                                    L"Up of Open and Import changes that.",
                                    42640),
                   axis)
            .ToUtf8();
    if (up.reason == Reason::writer)
        return KM_wString::FormatToString(
                   QnLocalizeString(L"%s is taken as up, as %s writes it; the option Up of Open "
                                    L"and Import changes that.",
                                    42641),
                   axis, KM_wString::FromUtf8(up.writer).Array())
            .ToUtf8();
    return {};
}

} // namespace quarn
