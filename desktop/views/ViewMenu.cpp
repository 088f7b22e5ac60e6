#include "desktop/views/ViewMenu.h"

#include "desktop/command_line/CommandStarter.h"
#include "desktop/texts/Texts.h"
#include "desktop/views/OpenViews.h"
#include "desktop/views/SizeMenu.h"
#include "desktop/views/ViewWidget.h"
#include "host/session/ViewFrame.h"

namespace quarn::desktop {

namespace {

struct Direction {
    const wchar_t* name;
    int text_id;
};
constexpr Direction DIRECTIONS[] = {
    {L"Top", 45010}, {L"Front", 45011}, {L"Right", 45012}, {L"Perspective", 45013}};

} // namespace

ViewMenu::ViewMenu(ViewContext context, ViewWidget& widget)
    : QObject(&widget), m_context(context), m_widget(widget) {
    connect(&widget.menu(), &QMenu::aboutToShow, this, &ViewMenu::fill);
}

void ViewMenu::fill() {
    QMenu& menu = m_widget.menu();
    menu.clear();
    addModes(menu);
    menu.addSeparator();
    connect(menu.addAction(localized(L"Fit to model", 45014)), &QAction::triggered, this,
            [this] { run("_-FitView _Enter"); });
    addDirections(*menu.addMenu(localized(L"Look from", 45015)));
    menu.addSeparator();
    addFrameSizes(*menu.addMenu(localized(L"Frame size", 45016)));
    menu.addSeparator();
    connect(menu.addAction(m_widget.maximizeButton().toolTip()), &QAction::triggered, &m_widget,
            &ViewWidget::maximizeClicked);
    const bool is_free = !m_context.session.isCommandRunning();
    for (QAction* const action : menu.actions())
        action->setEnabled(is_free);
    menu.actions().last()->setEnabled(true);
}

void ViewMenu::addModes(QMenu& menu) {
    CQuarnView* const view = findView(m_context.session.document(), m_widget.viewName());
    const CDisplayPipelineAttributes* const current = view ? view->DisplayAttributes() : nullptr;
    KM_SimpleArray<const CDisplayPipelineAttributes*> modes;
    CQuarnDisplayAttrsMgr::GetDisplayAttrsList(modes);
    auto* const group = new QActionGroup(&menu);
    for (int i = 0; i < modes.Count(); ++i) {
        const CDisplayPipelineAttributes& mode = *modes[i];
        QAction& action = addChoice(menu, *group, qtText(mode.LocalName()),
                                    current && current->Id() == mode.Id());
        connect(&action, &QAction::triggered, this,
                [this, option = qtText(QnCleanedModeName(mode.EnglishName()))] {
                    run("_-DisplayMode _" + option);
                });
    }
}

void ViewMenu::addDirections(QMenu& menu) {
    for (const Direction& direction : DIRECTIONS)
        connect(menu.addAction(localized(direction.name, direction.text_id)), &QAction::triggered,
                this, [this, name = qtText(direction.name)] { run("_-StandardView _" + name); });
}

void ViewMenu::addFrameSizes(QMenu& menu) {
    addSizes(menu, m_widget.fixedFrame(), [this](std::optional<QSize> size_px) {
        if (size_px)
            run(QString("_-ViewportSize %1 %2").arg(size_px->width()).arg(size_px->height()));
        else
            emit frameFreed();
    });
}

/// Commands work in the active view.
void ViewMenu::run(const QString& line) {
    if (m_context.session.isCommandRunning())
        return;
    if (CQuarnView* const view = findView(m_context.session.document(), m_widget.viewName())) {
        activateView(*view);
        m_context.starter.start(line);
    }
}

} // namespace quarn::desktop
