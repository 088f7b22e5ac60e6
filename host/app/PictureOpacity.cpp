#include "host/app/PictureOpacity.h"

#include "engine/images/ImageFile.h"
#include "host/document/Document.h"
#include "sdk/qncore/QnLocalize.h"

namespace quarn {

std::optional<std::string> whyHoldsNoOpacity(std::string_view extension) {
    const auto format = imageFormatFor(extension);
    if (!format || holdsOpacity(*format))
        return std::nullopt;
    const std::string kind(extension.substr(extension.starts_with('.') ? 1 : 0));
    return KM_wString::FormatToString(
               QnLocalizeString(L"Pictures of the kind %s have no opacity, and the background is "
                                L"transparent. Choose png, or another background with "
                                L"RenderSettings.",
                                42925),
               KM_wString::FromUtf8(kind).Array())
        .ToUtf8();
}

std::optional<std::string> whyNotSeeThrough(const Document& document, std::string_view extension) {
    const LightChoice& light = document.renderWindow().settings.light;
    return light.background == BackgroundKind::transparent ? whyHoldsNoOpacity(extension)
                                                           : std::nullopt;
}

} // namespace quarn
