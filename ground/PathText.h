#pragma once

#include "kelmar/KM_wString.h"

#include <filesystem>
#include <string>
#include <string_view>

namespace quarn {

/// The path that a text names, in UTF-8, as the system takes it. A path that the system accepts is
/// short, and then lies in the object itself: frames are written without asking the heap for it.
class SystemPath {
public:
    explicit SystemPath(std::wstring_view text);
    SystemPath(const SystemPath&) = delete;
    SystemPath& operator=(const SystemPath&) = delete;

    const char* c_str() const { return m_long.empty() ? m_short : m_long.c_str(); }
    std::string_view view() const { return c_str(); }

private:
    static constexpr std::size_t most_short_bytes = 4096; ///< with the 0 at the end

    char m_short[most_short_bytes];
    std::string m_long; ///< empty unless the path is too long for the other
};

/// The path that a text names; file names are UTF-8 whatever the locale says.
std::filesystem::path pathFromText(std::wstring_view text);

/// The text of a path; bytes that are not UTF-8 are shown as U+FFFD.
KM_wString textFromPath(const std::filesystem::path& path);

} // namespace quarn
