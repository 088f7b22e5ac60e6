#include "desktop/views/SizeMenu.h"

#include "desktop/texts/Texts.h"

namespace quarn::desktop {

QAction& addChoice(QMenu& menu, QActionGroup& group, const QString& text, bool is_checked) {
    QAction& action = *menu.addAction(text);
    action.setCheckable(true);
    action.setChecked(is_checked);
    group.addAction(&action);
    return action;
}

QList<QSize> offeredSizes() {
    return {{1280, 720}, {1920, 1080}, {3840, 2160}};
}

QString sizeText(const QSize& size_px) {
    return QString("%1 × %2").arg(size_px.width()).arg(size_px.height());
}

void addSizes(QMenu& menu, const std::optional<QSize>& present,
              const std::function<void(std::optional<QSize>)>& choose) {
    auto* const group = new QActionGroup(&menu);
    const auto add = [&](const QString& text, const std::optional<QSize>& size_px) {
        QObject::connect(&addChoice(menu, *group, text, present == size_px), &QAction::triggered,
                         group, [choose, size_px] { choose(size_px); });
    };
    add(localized(L"As in the window", 45017), std::nullopt);
    QList<QSize> sizes = offeredSizes();
    if (present && !sizes.contains(*present))
        sizes.append(*present);
    for (const QSize& size_px : std::as_const(sizes))
        add(sizeText(size_px), size_px);
}

} // namespace quarn::desktop
