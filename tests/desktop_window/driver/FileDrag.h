#pragma once

#include <QPoint>

#include <filesystem>
#include <string>

namespace quarn::test {

/// Another program whose file is dragged to a window and let go there, by the protocol of drag and
/// drop on X (freedesktop.org, "XDND", version 5).
/// @param display  as Display::name
/// @param window   the top window that it is dropped on
/// @param at       where, on the screen
/// @return whether the window took it
bool dropFile(const std::string& display, unsigned window, QPoint at,
              const std::filesystem::path& file);

} // namespace quarn::test
