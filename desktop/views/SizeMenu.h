#pragma once

#include <QActionGroup>
#include <QMenu>
#include <QSize>

#include <functional>
#include <optional>

namespace quarn::desktop {

/// Adds an entry to a menu, of whose group one at most is checked.
QAction& addChoice(QMenu& menu, QActionGroup& group, const QString& text, bool is_checked);

/// The sizes of pictures that menus offer, in pixels.
QList<QSize> offeredSizes();

/// "1280 × 720".
QString sizeText(const QSize& size_px);

/// Adds the offered sizes to a menu, and the size of the window, which nothing stands for.
/// @param present  is checked, and added where it is not among those that are offered
/// @param choose   is called with the one that is picked; lives as long as the menu's entries
void addSizes(QMenu& menu, const std::optional<QSize>& present,
              const std::function<void(std::optional<QSize>)>& choose);

} // namespace quarn::desktop
