#include "desktop/render/RenderPictureWindow.h"

#include "desktop/front_end/ShownImage.h"
#include "desktop/render/PictureSheet.h"
#include "desktop/texts/Texts.h"

#include <QAction>
#include <QActionGroup>
#include <QCloseEvent>
#include <QHBoxLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QProgressBar>
#include <QScreen>
#include <QScrollArea>
#include <QToolBar>
#include <QVBoxLayout>

#include <algorithm>
#include <cmath>

namespace quarn::desktop {
namespace {

constexpr int FAREWELL_MS = 400;
constexpr qint64 LONG_RENDERING_MS = 500;

} // namespace

RenderPictureWindow::RenderPictureWindow(QWidget* main_window) : QWidget(main_window, Qt::Window) {
    setObjectName("render_window");
    setWindowTitle(localized(L"Render window", 45350));
    m_sheet = new PictureSheet;
    m_sheet->setObjectName("picture");
    m_sheet->setAccessibleName(windowTitle());
    m_area = new QScrollArea(this);
    m_area->setFrameShape(QFrame::NoFrame);
    m_area->setAlignment(Qt::AlignCenter);
    m_area->setBackgroundRole(QPalette::Dark);
    m_area->setWidget(m_sheet);
    auto* const column = new QVBoxLayout(this);
    column->setContentsMargins(0, 0, 0, 0);
    column->setSpacing(0);
    column->addWidget(makeTools());
    column->addWidget(m_area, 1);
    column->addWidget(makeFoot());
    m_farewell.setSingleShot(true);
    connect(&m_farewell, &QTimer::timeout, this, &QWidget::hide);
    showProgress(1.0);
}

QAction* RenderPictureWindow::addTool(QToolBar& tools, const char* name, const QString& text,
                                      const QString& hint) {
    QAction* const tool = tools.addAction(text);
    tool->setObjectName(name);
    tool->setToolTip(hint);
    return tool;
}

QToolBar* RenderPictureWindow::makeTools() {
    auto* const tools = new QToolBar(this);
    tools->setToolButtonStyle(Qt::ToolButtonTextOnly);
    m_fit = addTool(*tools, "fit", localized(L"Fit", 45351),
                    localized(L"Shows the whole picture", 45352));
    m_whole = addTool(*tools, "whole", localized(L"100 %", 45353),
                      localized(L"Shows each pixel of the picture as one of the screen's", 45354));
    auto* const sizes = new QActionGroup(this);
    for (QAction* size : {m_fit, m_whole}) {
        size->setCheckable(true);
        sizes->addAction(size);
    }
    m_fit->setChecked(true);
    tools->addSeparator();
    m_save = addTool(*tools, "save", localized(L"Save as...", 45355),
                     localized(L"Writes the picture into a file", 45356));
    m_save->setShortcut(QKeySequence::Save);
    m_stop = addTool(*tools, "stop", localized(L"Stop", 45357),
                     localized(L"Ends rendering and brings the earlier picture back", 45361));
    connect(sizes, &QActionGroup::triggered, this, &RenderPictureWindow::fit);
    connect(m_save, &QAction::triggered, this, &RenderPictureWindow::saveRequested);
    connect(m_stop, &QAction::triggered, this, &RenderPictureWindow::stopRequested);
    return tools;
}

QWidget* RenderPictureWindow::makeFoot() {
    auto* const foot = new QWidget(this);
    m_numbers = new QLabel(foot);
    m_numbers->setObjectName("numbers");
    m_progress = new QProgressBar(foot);
    m_progress->setObjectName("progress");
    m_progress->setRange(0, 1000);
    m_progress->setAccessibleName(localized(L"Rendering", 45359));
    auto* const row = new QHBoxLayout(foot);
    row->setContentsMargins(10, 5, 10, 5);
    row->addWidget(m_numbers);
    row->addStretch(1);
    row->addWidget(m_progress);
    return foot;
}

void RenderPictureWindow::showPicture(const ShownPicture& picture) {
    const QImage image = imageOf(picture);
    if (image.isNull()) {
        m_sheet->setPicture({});
        m_farewell.start(FAREWELL_MS);
        return;
    }
    m_farewell.stop();
    const bool is_other_size = image.size() != m_sheet->picture().size();
    m_sheet->setPicture(image);
    if (!isVisible()) {
        if (is_other_size)
            growToPicture();
        show();
    }
    fit();
}

/// As large as the picture, but for three quarters of the screen at most.
void RenderPictureWindow::growToPicture() {
    const QSize most = screen()->availableSize() * 3 / 4;
    const QSize picture = m_sheet->picture().size() / devicePixelRatioF();
    const QSize around = sizeHint() - m_area->sizeHint();
    resize((picture + QSize(0, std::max(0, around.height())))
               .boundedTo(most)
               .expandedTo(minimumSizeHint()));
}

void RenderPictureWindow::showProgress(double share) {
    if (share < 1.0 && !m_is_rendering)
        m_since_start.start();
    m_is_rendering = share < 1.0;
    m_progress->setValue(static_cast<int>(std::lround(std::clamp(share, 0.0, 1.0) * 1000)));
    m_progress->setVisible(m_is_rendering);
    m_stop->setVisible(m_is_rendering);
    m_save->setEnabled(!m_is_rendering);
    showWhenItTakesLong();
}

/// A first picture that was stopped before there was any leaves nothing to show.
void RenderPictureWindow::showWhenItTakesLong() {
    if (!m_is_rendering) {
        if (m_sheet->picture().isNull())
            m_farewell.start(FAREWELL_MS);
        return;
    }
    m_farewell.stop();
    if (!isVisible() && m_since_start.elapsed() >= LONG_RENDERING_MS) {
        resize(sizeHint().expandedTo({640, 420}));
        show();
    }
}

void RenderPictureWindow::setFitting(bool is_fitting) {
    (is_fitting ? m_fit : m_whole)->setChecked(true);
    fit();
}

double RenderPictureWindow::scale() const {
    return m_sheet->scale();
}

void RenderPictureWindow::fit() {
    m_sheet->fitInto(m_fit->isChecked() ? m_area->maximumViewportSize() : QSize());
    showNumbers();
}

void RenderPictureWindow::showNumbers() {
    const QSize size = m_sheet->picture().size();
    if (size.isEmpty())
        return m_numbers->clear();
    m_numbers->setText(localized(L"%1 x %2 pixels, %3 %", 45360)
                           .arg(size.width())
                           .arg(size.height())
                           .arg(std::lround(scale() * 100)));
}

void RenderPictureWindow::resizeEvent(QResizeEvent* event) {
    QWidget::resizeEvent(event);
    fit();
}

void RenderPictureWindow::keyPressEvent(QKeyEvent* event) {
    if (event->key() == Qt::Key_Escape)
        close();
    else
        QWidget::keyPressEvent(event);
}

/// A picture that is being made belongs to a command, which ends first.
void RenderPictureWindow::closeEvent(QCloseEvent* event) {
    if (isRendering()) {
        event->ignore();
        emit stopRequested();
        return;
    }
    event->accept();
    emit closedByPerson();
}

} // namespace quarn::desktop
