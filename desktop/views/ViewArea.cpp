#include "desktop/views/ViewArea.h"

#include "desktop/command_line/CommandStarter.h"
#include "desktop/documents/StartedLine.h"
#include "desktop/texts/Texts.h"
#include "desktop/views/OpenViews.h"
#include "desktop/views/SizeMenu.h"
#include "desktop/views/ViewMenu.h"
#include "desktop/views/ViewMouse.h"
#include "desktop/views/ViewWidget.h"
#include "host/session/AnimationState.h"
#include "host/session/DocumentState.h"
#include "host/session/ViewFrame.h"

#include <QVBoxLayout>

namespace quarn::desktop {

namespace {

QSize frameSizeOf(CQuarnView& view) {
    CQuarnDisplayPipeline& pipeline = *view.MainViewport().DisplayPipeline();
    return {pipeline.FrameWidth(), pipeline.FrameHeight()};
}

} // namespace

ViewArea::ViewArea(ViewContext context, QWidget* parent)
    : QWidget(parent), m_context(context), m_drawing(context, [this] { return m_widgets; }),
      m_grid(new ViewGrid(this)) {
    setObjectName("views");
    auto* const layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(m_grid);
    connect(&context.starter, &CommandStarter::started, this, &ViewArea::commandStarted);
    connect(&context.starter, &CommandStarter::ended, this, &ViewArea::commandEnded);
    refresh();
}

ViewWidget* ViewArea::widget(const QString& view_name) const {
    for (ViewWidget* const widget : m_widgets)
        if (widget->viewName() == view_name)
            return widget;
    return nullptr;
}

void ViewArea::showPicture(CQuarnView& view, const ShownPicture& picture) {
    if (view.Document().RuntimeSerialNumber() != m_document_number)
        return;
    const QString name = qtText(view.MainViewport().Name());
    if (m_context.session.isCommandRunning() && !m_drawing.isDrawing())
        m_shown_by_command.insert(name, lookOf(view));
    if (ViewWidget* const shown = widget(name))
        shown->setPicture(picture);
}

void ViewArea::commandStarted(const QString& line) {
    m_shown_by_command.clear();
    if (readLine(m_context.session, line).english_name == "RecordAnimation")
        sizeForRecording();
}

void ViewArea::commandEnded() {
    noteFrameSizes();
    refresh();
    m_drawing.wantAll();
    for (auto [name, look] : m_shown_by_command.asKeyValueRange()) {
        const CQuarnView* const view = findView(m_context.session.document(), name);
        if (view && lookOf(*view) == look)
            m_drawing.forget(name);
    }
    fitFrames();
}

ViewArea::Look ViewArea::lookOf(const CQuarnView& view) {
    const CDisplayPipelineAttributes* const mode = view.DisplayAttributes();
    return {view.MainViewport().VP(), mode ? mode->Id() : KM_nil_uuid};
}

void ViewArea::refresh() {
    CQuarnDoc& document = m_context.session.document();
    const bool is_other_document = document.RuntimeSerialNumber() != m_document_number;
    QStringList names = viewNames(document);
    QStringList shown;
    for (ViewWidget* const widget : std::as_const(m_widgets))
        shown.append(widget->viewName());
    if (is_other_document) {
        m_document_number = document.RuntimeSerialNumber();
        m_given_sizes.clear();
        m_shown_by_command.clear();
    }
    if (is_other_document || names != shown)
        rebuild(names);
    showActive();
    showHint();
}

void ViewArea::rebuild(const QStringList& names) {
    QMap<QString, ViewWidget*> old;
    for (ViewWidget* const widget : std::as_const(m_widgets))
        old.insert(widget->viewName(), widget);
    m_widgets.clear();
    for (const QString& name : names) {
        ViewWidget* const kept = m_given_sizes.contains(name) ? old.take(name) : nullptr;
        m_widgets.append(kept ? kept : &addWidget(name));
    }
    QList<QWidgetList> rows;
    for (const QStringList& row : gridRows(names)) {
        rows.append(QWidgetList());
        for (const QString& name : row)
            rows.last().append(widget(name));
    }
    m_grid->setRows(rows);
    for (ViewWidget* const gone : std::as_const(old))
        gone->deleteLater();
    for (const QString& name : m_given_sizes.keys())
        if (!names.contains(name))
            m_given_sizes.remove(name);
    m_drawing.wantAll();
}

ViewWidget& ViewArea::addWidget(const QString& name) {
    auto* const widget = new ViewWidget(name, this);
    new ViewMouse(m_context, m_drawing, *widget);
    auto* const menu = new ViewMenu(m_context, *widget);
    connect(menu, &ViewMenu::frameFreed, this, [this, widget] {
        widget->setFixedFrame(std::nullopt);
        fitFrames();
    });
    connect(widget, &ViewWidget::frameChanged, this, [this, widget] {
        fitFrames();
        m_drawing.wantMoving(widget->viewName());
    });
    connect(widget, &ViewWidget::activated, this, &ViewArea::showActive);
    connect(widget, &ViewWidget::maximizeClicked, this,
            [this, widget] { toggleMaximized(widget->viewName()); });
    return *widget;
}

/// A size that the window did not give was chosen by a command: it is kept.
void ViewArea::noteFrameSizes() {
    CQuarnDoc& document = m_context.session.document();
    if (document.RuntimeSerialNumber() != m_document_number)
        return;
    for (auto given = m_given_sizes.begin(); given != m_given_sizes.end(); ++given) {
        CQuarnView* const view = findView(document, given.key());
        if (!view || frameSizeOf(*view) == *given)
            continue;
        *given = frameSizeOf(*view);
        widget(given.key())->setFixedFrame(*given);
    }
}

void ViewArea::fitFrames() {
    if (m_context.session.isCommandRunning())
        return;
    m_drawing.fitFrames();
    for (ViewWidget* const widget : std::as_const(m_widgets))
        if (CQuarnView* const view = findView(m_context.session.document(), widget->viewName()))
            m_given_sizes[widget->viewName()] = frameSizeOf(*view);
    emit frameChanged();
}

/// The view that the animation is made for; before there is one, the view that is worked in.
ViewWidget* ViewArea::recordedWidget() const {
    CQuarnDoc& document = m_context.session.document();
    const AnimationState animation = animationState(document);
    ViewWidget* const animated = animation.can_play ? widget(qtText(animation.view)) : nullptr;
    return animated ? animated : widget(activeViewName(document));
}

QSize ViewArea::recordedSize() const {
    const ViewWidget* const widget = recordedWidget();
    if (widget && widget->fixedFrame())
        return *widget->fixedFrame();
    if (m_recorded_size.chosen() || !widget)
        return m_recorded_size.chosen().value_or(QSize());
    return widget->wantedFrame();
}

void ViewArea::chooseRecordedSize(std::optional<QSize> size_px) {
    m_recorded_size.choose(size_px);
    if (ViewWidget* const widget = recordedWidget())
        widget->setFixedFrame(std::nullopt);
    fitFrames();
}

/// Nothing else of the window changes: the frame has the window's size again when the command has
/// ended.
void ViewArea::sizeForRecording() {
    const ViewWidget* const widget = recordedWidget();
    CQuarnView* const view =
        widget ? findView(m_context.session.document(), widget->viewName()) : nullptr;
    const QSize size_px = recordedSize();
    if (view && setFrameSize(*view, size_px.width(), size_px.height()))
        m_given_sizes[widget->viewName()] = size_px;
}

void ViewArea::fillRecordedSizes(QMenu& menu) {
    menu.clear();
    delete menu.findChild<QActionGroup*>();
    const ViewWidget* const widget = recordedWidget();
    const bool is_fixed = widget && widget->fixedFrame();
    addSizes(menu, is_fixed ? widget->fixedFrame() : m_recorded_size.chosen(),
             [this](std::optional<QSize> size_px) { chooseRecordedSize(size_px); });
}

void ViewArea::showActive() {
    const QString active = activeViewName(m_context.session.document());
    for (ViewWidget* const widget : std::as_const(m_widgets))
        widget->setActive(widget->viewName() == active);
    emit frameChanged();
}

void ViewArea::showHint() {
    CQuarnDoc& document = m_context.session.document();
    const QString active = activeViewName(document);
    const bool is_empty = objectCount(document) == 0;
    for (ViewWidget* const widget : std::as_const(m_widgets))
        widget->setHint(is_empty && widget->viewName() == active
                            ? localized(L"Drop a model here or choose File > Open", 45005)
                            : QString());
}

void ViewArea::toggleActiveMaximized() {
    toggleMaximized(activeViewName(m_context.session.document()));
}

void ViewArea::toggleMaximized(const QString& view_name) {
    ViewWidget* const wanted = widget(view_name);
    m_grid->maximize(m_grid->maximized() ? nullptr : wanted);
    for (ViewWidget* const widget : std::as_const(m_widgets))
        widget->setMaximized(m_grid->maximized() == widget);
}

} // namespace quarn::desktop
