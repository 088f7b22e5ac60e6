#include "desktop/animation/AnimationBar.h"

#include "desktop/animation/ProgressRow.h"
#include "desktop/animation/SharedFileRow.h"
#include "desktop/command_line/CommandStarter.h"
#include "desktop/texts/Texts.h"
#include "host/session/Session.h"
#include "sdk/qncore/QnView.h"

#include <QAction>
#include <QEvent>
#include <QTimer>
#include <QVBoxLayout>

namespace quarn::desktop {

namespace {

constexpr const char* PLAY_LINE = "_PlayAnimation";
constexpr int MARGIN_PX = 6;
const QColor RECORD_RED(0xd9, 0x2d, 0x20);

} // namespace

AnimationBar::AnimationBar(Session& session, CommandStarter& starter, QWidget* parent)
    : QWidget(parent), m_session(session), m_starter(starter), m_row(new QHBoxLayout),
      m_progress(new ProgressRow(this)), m_shared_file(new SharedFileRow(this)) {
    setObjectName("animationBar");
    auto* const column = new QVBoxLayout(this);
    column->setContentsMargins(MARGIN_PX, MARGIN_PX / 2, MARGIN_PX, MARGIN_PX / 2);
    column->addLayout(m_row);
    column->addWidget(m_progress);
    column->addWidget(m_shared_file);
    m_progress->hide();
    m_shared_file->hide();
    buildControls();
    connectControls();
    paintIcons();
    refresh();
}

void AnimationBar::buildControls() {
    addButton("firstFrame", localized(L"First frame", 45201), MediaSign::first, "_ViewFirstFrame");
    addButton("previousFrame", localized(L"Previous frame", 45202), MediaSign::previous,
              "_ViewPreviousFrame");
    m_play = addButton("play", localized(L"Play", 45203), MediaSign::play);
    addButton("nextFrame", localized(L"Next frame", 45204), MediaSign::next, "_ViewNextFrame");
    addButton("lastFrame", localized(L"Last frame", 45205), MediaSign::last, "_ViewLastFrame");

    m_slider = new QSlider(Qt::Horizontal, this);
    m_slider->setObjectName("frameSlider");
    m_slider->setAccessibleName(localized(L"Frame", 45206));
    m_slider->setToolTip(localized(L"Drag to look through the frames", 45207));
    m_row->addWidget(m_slider, 1);
    m_number = new QSpinBox(this);
    m_number->setObjectName("frameNumber");
    m_number->setAccessibleName(localized(L"Frame number", 45208));
    m_number->setToolTip(localized(L"Number of the frame; the first is 0", 45209));
    m_number->setKeyboardTracking(false);
    m_number->setAlignment(Qt::AlignRight);
    m_row->addWidget(m_number);
    m_date = new QLabel(this);
    m_date->setObjectName("frameDate");
    m_date->setTextFormat(Qt::PlainText);
    m_row->addWidget(m_date);

    m_record = addButton(
        "record", localized(L"Saves every frame as a picture, and a page that plays them", 45210),
        MediaSign::record);
    m_record->setText(localized(L"Record…", 45211));
    m_record->setToolButtonStyle(Qt::ToolButtonTextBesideIcon);
    m_open_page = new QAction(localized(L"Open page", 45212), this);
    m_open_page->setObjectName("openPage");
    m_open_page->setToolTip(localized(L"Opens the page of the recording in the browser", 45213));
    m_open_page->setStatusTip(m_open_page->toolTip());
    m_page_button = addButton("openPageButton", {}, MediaSign::page);
    m_page_button->setDefaultAction(m_open_page);
    m_page_button->setToolButtonStyle(Qt::ToolButtonTextBesideIcon);
}

/// @param line  the command line that a click starts; empty: none
QToolButton* AnimationBar::addButton(const char* name, const QString& tip, MediaSign sign,
                                     const QString& line) {
    auto* const button = new QToolButton(this);
    button->setObjectName(name);
    button->setToolTip(tip);
    button->setAccessibleName(tip);
    button->setAutoRaise(true);
    button->setFocusPolicy(Qt::TabFocus);
    if (!line.isEmpty())
        connect(button, &QToolButton::clicked, this, [this, line] { m_starter.start(line); });
    m_row->addWidget(button);
    m_signs.append({button, sign});
    return button;
}

void AnimationBar::connectControls() {
    connect(m_play, &QToolButton::clicked, this, &AnimationBar::playOrStop);
    connect(m_record, &QToolButton::clicked, this, &AnimationBar::record);
    connect(m_slider, &QSlider::valueChanged, this, &AnimationBar::wantFrame);
    connect(m_number, &QSpinBox::valueChanged, this, &AnimationBar::wantFrame);
    connect(m_open_page, &QAction::triggered, this, [this] { m_starter.start(*m_page_line); });
    connect(m_progress, &ProgressRow::cancelled, &m_starter, &CommandStarter::stop);
    connect(m_shared_file, &SharedFileRow::lineChosen, &m_starter, &CommandStarter::start);
    connect(&m_starter, &CommandStarter::started, this, &AnimationBar::commandStarted);
    connect(&m_starter, &CommandStarter::ended, this, &AnimationBar::commandEnded);
}

void AnimationBar::addControl(QWidget* control) {
    m_row->insertWidget(m_row->indexOf(m_record), control);
}

void AnimationBar::refresh() {
    m_animation = animationSummary(m_session.document());
    m_page_line = pageOpeningLine(m_animation.state);
    if (!m_wanted_frame)
        showFrameNumber(m_animation.state.current_frame);
    showState();
}

void AnimationBar::record() {
    m_starter.start(recordingLine(m_session.document()));
}

void AnimationBar::playOrStop() {
    if (isPlaying())
        m_starter.stop();
    else
        m_starter.start(PLAY_LINE);
}

bool AnimationBar::isPlaying() const {
    return m_starter.line().compare(PLAY_LINE, Qt::CaseInsensitive) == 0;
}

/// The starter announces a command before it runs.
bool AnimationBar::isCommandStarted() const {
    return m_starter.isRunning() || !m_starter.line().isEmpty();
}

void AnimationBar::commandStarted(const QString&) {
    m_pictures_shown = 0;
    m_progress->begin();
    showState();
}

void AnimationBar::commandEnded() {
    m_progress->hide();
    refresh();
}

void AnimationBar::frameWritten(const std::filesystem::path&, int written, int total) {
    m_shared_file->hide();
    m_progress->showFrame(written, total);
    showFrameNumber(written - 1);
}

void AnimationBar::pictureRendered(double share) {
    m_progress->showPicture(share);
}

void AnimationBar::modelRead(ModelStep step, double share) {
    m_progress->showModel(step, share);
}

void AnimationBar::sharedFileProgress(const std::filesystem::path& file, double share) {
    m_shared_file->hide();
    m_progress->showSharedFile(file, share);
}

void AnimationBar::sharedFileEnded(const SharedFileReport& report) {
    m_progress->hide();
    m_shared_file->showReport(report);
}

/// The first picture is of the display mode, before any frame.
void AnimationBar::viewShown(const CQuarnView& view) {
    const bool is_animated =
        qtText(view.MainViewport().Name())
            .compare(qtText(m_animation.state.view).trimmed(), Qt::CaseInsensitive) == 0;
    if (!isPlaying() || !is_animated)
        return;
    if (++m_pictures_shown > 1)
        showFrameNumber(std::min(m_pictures_shown - 2, m_animation.lastFrame()));
}

/// While a frame is drawn others may be asked for: only the newest of them is drawn next.
void AnimationBar::wantFrame(int frame) {
    const bool is_due = !m_wanted_frame;
    m_wanted_frame = frame;
    showFrameNumber(frame);
    if (is_due)
        QTimer::singleShot(0, this, &AnimationBar::showWantedFrame);
}

void AnimationBar::showWantedFrame() {
    if (!m_wanted_frame || isCommandStarted() || !m_animation.state.can_play) {
        m_wanted_frame.reset();
        refresh();
        return;
    }
    const int frame = *m_wanted_frame;
    m_is_stepping = true;
    m_starter.start("_ViewFrameNumber " + QString::number(frame));
    m_is_stepping = false;
    const bool is_newest = m_wanted_frame == frame;
    if (!is_newest) {
        QTimer::singleShot(0, this, &AnimationBar::showWantedFrame);
        return;
    }
    m_wanted_frame.reset();
    refresh();
}

void AnimationBar::showFrameNumber(int frame) {
    const QSignalBlocker quiet_slider(m_slider);
    const QSignalBlocker quiet_number(m_number);
    const int last = m_animation.lastFrame();
    m_slider->setRange(0, last);
    m_slider->setPageStep(std::max(1, last / 10));
    m_slider->setValue(frame);
    m_number->setRange(0, last);
    m_number->setSuffix(QString(" / %1").arg(last));
    m_number->setValue(frame);
    const QString date = m_animation.dateOf(frame);
    m_date->setText(date);
    m_date->setVisible(!date.isEmpty());
}

/// A slider that is being dragged stays enabled: it would lose the mouse.
void AnimationBar::showState() {
    const bool is_free = !isCommandStarted() || m_is_stepping;
    for (const Sign& sign : m_signs)
        sign.button->setEnabled(is_free && m_animation.state.can_play);
    m_slider->setEnabled(is_free && m_animation.state.can_play);
    m_number->setEnabled(is_free && m_animation.state.can_play);
    m_open_page->setEnabled(is_free && m_page_line.has_value());
    m_page_button->setVisible(m_page_line.has_value());
    m_play->setEnabled(m_animation.state.can_play && (is_free || isPlaying()));
    m_play->setToolTip(isPlaying() ? localized(L"Stop", 45214) : localized(L"Play", 45203));
    m_play->setAccessibleName(m_play->toolTip());
    m_shared_file->setFree(is_free);
    paintIcons();
}

void AnimationBar::paintIcons() {
    const QColor colour = palette().color(QPalette::Active, QPalette::ButtonText);
    const QColor disabled = palette().color(QPalette::Disabled, QPalette::ButtonText);
    for (const Sign& sign : m_signs) {
        const bool stops = sign.button == m_play && isPlaying();
        const bool records = sign.sign == MediaSign::record;
        const QIcon icon =
            mediaIcon(stops ? MediaSign::stop : sign.sign, records ? RECORD_RED : colour, disabled);
        if (sign.button == m_page_button)
            m_open_page->setIcon(icon);
        else
            sign.button->setIcon(icon);
    }
}

void AnimationBar::changeEvent(QEvent* event) {
    if (event->type() == QEvent::PaletteChange && m_number)
        paintIcons();
    QWidget::changeEvent(event);
}

} // namespace quarn::desktop
