#pragma once

class QDockWidget;

namespace quarn::desktop {

class MainWindow;

/// Adds to the menus what changes the window alone and is no command: one view or all of them, and
/// the command line.
void addWindowActions(MainWindow& window, QDockWidget& command_dock);

/// Adds to the animation bar how large the pictures will be, with a menu of sizes.
void addFrameSizeButton(MainWindow& window);

} // namespace quarn::desktop
