#include "ground/PathText.h"

namespace quarn {

std::filesystem::path pathFromText(std::wstring_view text) {
    return KM_wString(text).ToUtf8();
}

KM_wString textFromPath(const std::filesystem::path& path) {
    return KM_wString::FromUtf8(path.native());
}

} // namespace quarn
