#include "desktop/views/RecordedSize.h"

#include "desktop/views/SizeMenu.h"

#include <QSettings>

namespace quarn::desktop {

namespace {

/// Holds a size; an empty one stands for the window's.
constexpr const char* KEY = "animation/recorded_size";

} // namespace

RecordedSize::RecordedSize() {
    const QSize first = offeredSizes().first();
    const QSize kept = QSettings().value(KEY, first).toSize();
    if (!kept.isEmpty())
        m_chosen = offeredSizes().contains(kept) ? kept : first;
}

void RecordedSize::choose(std::optional<QSize> size_px) {
    m_chosen = size_px;
    QSettings().setValue(KEY, size_px.value_or(QSize(0, 0)));
}

} // namespace quarn::desktop
