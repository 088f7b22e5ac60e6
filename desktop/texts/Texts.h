#pragma once

#include "sdk/qncore/QnLocalize.h"

#include <QString>

#include <filesystem>
#include <string>
#include <string_view>

namespace quarn::desktop {

inline QString qtText(std::wstring_view text) {
    return QString::fromWCharArray(text.data(), static_cast<qsizetype>(text.size()));
}
inline QString qtText(const std::wstring& text) {
    return QString::fromStdWString(text);
}
inline QString qtText(const KM_wString& text) {
    return qtText(text.View());
}
inline QString qtText(const wchar_t* text) {
    return qtText(std::wstring_view(text));
}
inline QString qtText(const std::filesystem::path& path) {
    return QString::fromUtf8(path.native());
}

inline KM_wString wideText(const QString& text) {
    return KM_wString(std::wstring_view(text.toStdWString()));
}
inline std::filesystem::path nativePath(const QString& path) {
    return path.toStdString();
}

/// The text in the user's language.
/// @param id  its number in the tables of desktop/locale; as of QnLocalizeString
inline QString localized(const wchar_t* english, int id) {
    return qtText(QnLocalizeString(english, id));
}

} // namespace quarn::desktop
