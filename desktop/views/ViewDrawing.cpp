#include "desktop/views/ViewDrawing.h"

#include "desktop/views/OpenViews.h"
#include "desktop/views/ViewWidget.h"
#include "host/session/ViewFrame.h"

#include <QElapsedTimer>

namespace quarn::desktop {

namespace {

constexpr int REST_AFTER_MS = 160;
constexpr qint64 SMOOTH_MS = 30; ///< a moving picture that takes longer is drawn without smoothing

constexpr int SMOOTHING_OFF = 0; // antialiasing levels
constexpr int SMOOTHING_SCREEN = 1;

bool hasFrame(CQuarnView& view, const QSize& size_px) {
    CQuarnDisplayPipeline& pipeline = *view.MainViewport().DisplayPipeline();
    return QSize(pipeline.FrameWidth(), pipeline.FrameHeight()) == size_px;
}

/// The attributes belong to the view and to whoever draws it next: they come back as they were.
void redrawWith(CQuarnView& view, int antialiasing_level) {
    CDisplayPipelineAttributes* const attributes =
        view.MainViewport().DisplayPipeline()->CurrentDisplayAttributes();
    if (!attributes)
        return;
    const int level_before = attributes->m_antialiasing_level;
    attributes->m_antialiasing_level = antialiasing_level;
    view.Redraw();
    attributes->m_antialiasing_level = level_before;
}

} // namespace

ViewDrawing::ViewDrawing(ViewContext context, std::function<QList<ViewWidget*>()> widgets,
                         QObject* parent)
    : QObject(parent), m_context(context), m_widgets(std::move(widgets)) {
    m_turn.setSingleShot(true);
    m_turn.setInterval(0);
    m_rest.setSingleShot(true);
    m_rest.setInterval(REST_AFTER_MS);
    connect(&m_turn, &QTimer::timeout, this, &ViewDrawing::drawWanted);
    connect(&m_rest, &QTimer::timeout, this, &ViewDrawing::rest);
}

void ViewDrawing::mark(const QString& view_name, Quality quality) {
    const auto known = m_wanted.find(view_name);
    if (known == m_wanted.end())
        m_wanted.insert(view_name, quality);
    else if (quality == Quality::resting)
        *known = quality;
    m_turn.start();
}

void ViewDrawing::wantAll() {
    for (ViewWidget* const widget : m_widgets())
        want(widget->viewName());
}

void ViewDrawing::forget(const QString& view_name) {
    m_wanted.remove(view_name);
    m_moving.removeAll(view_name);
}

/// Host and widget agree on the size as soon as no command holds the view.
void ViewDrawing::fitFrames() {
    for (ViewWidget* const widget : m_widgets()) {
        CQuarnView* const view = findView(m_context.session.document(), widget->viewName());
        if (!view || !widget->isVisible() || hasFrame(*view, widget->wantedFrame()))
            continue;
        const QSize size_px = widget->wantedFrame();
        if (setFrameSize(*view, size_px.width(), size_px.height()))
            want(widget->viewName());
    }
}

bool ViewDrawing::isShown(const QString& view_name) const {
    for (ViewWidget* const widget : m_widgets())
        if (widget->viewName() == view_name)
            return widget->isVisible();
    return false;
}

/// A draw may let the front end work on events, and so come back here.
void ViewDrawing::drawWanted() {
    if (m_is_drawing || !m_context.areViewsFree())
        return;
    m_is_drawing = true;
    const QMap<QString, Quality> wanted = std::exchange(m_wanted, {});
    for (auto [name, quality] : wanted.asKeyValueRange())
        if (isShown(name))
            draw(name, quality);
    m_is_drawing = false;
}

void ViewDrawing::draw(const QString& view_name, Quality quality) {
    CQuarnView* const view = findView(m_context.session.document(), view_name);
    if (!view)
        return;
    m_moving.removeAll(view_name);
    if (quality == Quality::resting) {
        view->Redraw();
        return;
    }
    QElapsedTimer clock;
    clock.start();
    redrawWith(*view, m_quick_draw_ms > SMOOTH_MS ? SMOOTHING_OFF : SMOOTHING_SCREEN);
    m_quick_draw_ms = clock.elapsed();
    m_moving.append(view_name);
    m_rest.start();
}

void ViewDrawing::rest() {
    for (const QString& name : std::exchange(m_moving, {}))
        want(name);
}

} // namespace quarn::desktop
