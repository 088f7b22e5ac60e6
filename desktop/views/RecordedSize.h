#pragma once

#include <QSize>

#include <optional>

namespace quarn::desktop {

/// How large pictures are recorded, whatever the size of the window: kept from one run of the
/// program to the next (QSettings), 1280 x 720 before anything was chosen.
class RecordedSize {
public:
    RecordedSize();

    /// In pixels; nothing for pictures as large as the view is in the window.
    const std::optional<QSize>& chosen() const { return m_chosen; }
    void choose(std::optional<QSize> size_px);

private:
    std::optional<QSize> m_chosen;
};

} // namespace quarn::desktop
