#include "desktop/window/MainWindow.h"

#include "desktop/animation/AnimationBar.h"
#include "desktop/animation/RecordingText.h"
#include "desktop/command_line/CommandPane.h"
#include "desktop/command_line/CommandStarter.h"
#include "desktop/dialogs/Choosers.h"
#include "desktop/dialogs/FormWindow.h"
#include "desktop/dialogs/LocationDialog.h"
#include "desktop/dialogs/MessageBox.h"
#include "desktop/dialogs/UpAxisAsking.h"
#include "desktop/documents/FileDrop.h"
#include "desktop/documents/RecentFiles.h"
#include "desktop/documents/SessionEnd.h"
#include "desktop/documents/UnsavedChanges.h"
#include "desktop/documents/WindowClosing.h"
#include "desktop/menus/CommandMenus.h"
#include "desktop/recovery/RecoveryBeat.h"
#include "desktop/recovery/RecoveryOffer.h"
#include "desktop/render/RenderPictureWindow.h"
#include "desktop/sun/SunActions.h"
#include "desktop/texts/Texts.h"
#include "desktop/views/ViewArea.h"
#include "desktop/window/WindowActions.h"
#include "host/session/DocumentState.h"
#include "host/session/StopSignals.h"

#include <QApplication>
#include <QCloseEvent>
#include <QDockWidget>
#include <QLabel>
#include <QMenuBar>
#include <QScreen>
#include <QSettings>
#include <QStatusBar>
#include <QTimer>
#include <QVBoxLayout>

namespace quarn::desktop {

namespace {

constexpr unsigned LONGEST_KEEPING_S = 30; ///< a large document on a slow disk
constexpr int MESSAGE_MS = 8000;
constexpr QSize FIRST_SIZE{1280, 860};
constexpr QSize FRAME_ROOM{8, 40}; ///< that a window manager's frame may take
constexpr int FIRST_COMMAND_HEIGHT = 170;

constexpr const char* GEOMETRY = "window/geometry";
constexpr const char* PANELS = "window/panels";
constexpr const char* BORDERS = "window/view_borders";
constexpr int PANELS_VERSION = 1;

} // namespace

MainWindow::MainWindow(Session& session, DesktopFrontEnd& front_end)
    : m_session(session), m_front_end(front_end),
      m_starter(new CommandStarter(session, front_end, this)),
      m_pane(new CommandPane(session, this)),
      m_views(new ViewArea({session, *m_starter, *m_pane}, this)),
      m_animation(new AnimationBar(session, *m_starter, this)),
      m_menus(new CommandMenus(session, *m_starter, *menuBar())),
      m_recent_files(new RecentFiles(session, *m_starter, *this)),
      m_changes(new UnsavedChanges(session, *m_starter, *this)),
      m_closing(new WindowClosing(*m_starter, *m_pane, *m_changes, *this)),
      m_file_drop(new FileDrop(*m_starter, *m_changes, *this)),
      m_end(new ProgramEnd(*m_starter, *m_pane, this)),
      m_session_end(new SessionEnd(session, *m_starter, *m_closing, *m_changes, *m_end, this)),
      m_up_axis(new UpAxisAsking(this)),
      m_sun(new SunActions(session, front_end, *m_starter, *this)) {
    setObjectName("mainWindow");
    layOut();
    buildMenus();
    connectParts();
    front_end.setMainWindow(this);
    front_end.setParts(parts());
    showTitle();
    m_pane->line().setFocus();
}

/// The front end outlives the window: it must not reach for parts that are gone.
MainWindow::~MainWindow() {
    m_front_end.setParts({});
}

void MainWindow::layOut() {
    auto* const middle = new QWidget(this);
    auto* const column = new QVBoxLayout(middle);
    column->setContentsMargins(0, 0, 0, 0);
    column->setSpacing(0);
    column->addWidget(m_views, 1);
    column->addWidget(m_animation);
    setCentralWidget(middle);

    m_command_dock = new QDockWidget(localized(L"Command line", 45020), this);
    m_command_dock->setObjectName("commandDock");
    m_command_dock->setAllowedAreas(Qt::AllDockWidgetAreas);
    m_command_dock->setWidget(m_pane);
    addDockWidget(Qt::BottomDockWidgetArea, m_command_dock);

    auto* const mouse =
        new QLabel(localized(L"Right drag: turn   Shift + right drag: move   Wheel: zoom   "
                             L"Double click: fit   Click: select",
                             45021),
                   this);
    mouse->setObjectName("mouseWords");
    mouse->setEnabled(false);
    statusBar()->addPermanentWidget(mouse);
}

void MainWindow::buildMenus() {
    m_menus->addBelow("Open", {m_recent_files->menu().menuAction()});
    m_menus->addBelow("Import", {&m_up_axis->switchAction()});
    m_menus->menu(MenuPlace::sun).addSeparator();
    m_menus->menu(MenuPlace::sun).addActions(m_sun->actions());
    addWindowActions(*this, *m_command_dock);
    addFrameSizeButton(*this);
    m_menus->menu(MenuPlace::animation).addSeparator();
    m_menus->menu(MenuPlace::animation).addAction(&m_animation->openPageAction());
}

void MainWindow::connectParts() {
    connect(m_pane, &CommandPane::lineEntered, m_changes, &UnsavedChanges::start);
    connect(m_menus, &CommandMenus::lineChosen, m_changes, &UnsavedChanges::start);
    connect(&m_menus->stopAction(), &QAction::triggered, m_pane, &CommandPane::cancelQuestion);
    connect(m_recent_files, &RecentFiles::lineChosen, m_changes, &UnsavedChanges::start);
    connect(m_recent_files, &RecentFiles::missing, this, &MainWindow::tell);
    connect(m_file_drop, &FileDrop::refused, this, &MainWindow::tell);
    connect(m_starter, &CommandStarter::refused, this, &MainWindow::tell);
    connect(m_starter, &CommandStarter::started, this, [this](const QString& line) {
        if (!m_animation->isStepping())
            m_pane->showStarted(line);
    });
    connect(m_starter, &CommandStarter::ended, this, &MainWindow::commandEnded);
}

FrontEndParts MainWindow::parts() {
    FrontEndParts parts;
    parts.print = [this](std::wstring_view text) { m_pane->print(text); };
    parts.ask = [this](const Question& question) { return m_pane->ask(question); };
    parts.show_message = showMessageBox;
    parts.choose_folder = askFolder;
    parts.choose_file = [this](QWidget* owner, const FileQuestion& question) {
        FileChoice choice = askFile(owner, question);
        m_recent_files->noteChoice(question, choice);
        return choice;
    };
    parts.choose_place = askPlace;
    parts.choose_up_axis = [this](QWidget* owner, const UpAxisQuestion& question) {
        return m_up_axis->ask(owner, question);
    };
    parts.make_dialog = makeFormWindow;
    parts.frame_written = [this](const std::filesystem::path& file, int written, int total) {
        m_animation->frameWritten(file, written, total);
    };
    parts.recording_ended = [this](const RecordingReport& report) { noteRecording(report); };
    parts.shared_file_progress = [this](const std::filesystem::path& file, double share) {
        m_animation->sharedFileProgress(file, share);
    };
    parts.shared_file_ended = [this](const SharedFileReport& report) { noteSharedFile(report); };
    parts.picture_rendered = [this](double share) { showRenderProgress(share); };
    parts.model_read = [this](ModelStep step, double share) {
        m_animation->modelRead(step, share);
    };
    parts.view_shown = [this](CQuarnView& view, const ShownPicture& picture) {
        m_views->showPicture(view, picture);
        m_animation->viewShown(view);
    };
    parts.render_window_shown = [this](const ShownPicture& picture) {
        showRenderedPicture(picture);
    };
    return parts;
}

void MainWindow::commandEnded() {
    m_menus->refresh();
    showTitle();
    if (m_session.isExitRequested())
        QTimer::singleShot(0, this, &QWidget::close);
}

void MainWindow::showTitle() {
    CQuarnDoc& document = m_session.document();
    const std::filesystem::path file = documentFile(document);
    const QString name = file.empty() ? localized(L"New document", 45022) : qtText(file.filename());
    setWindowTitle(QString(name).replace("[*]", "[*][*]") + "[*] – Quarn"); // the mark of changes
    setWindowModified(isModified(document));
    setWindowFilePath(file.empty() ? QString() : qtText(file));
}

RenderPictureWindow& MainWindow::renderWindow() {
    if (m_render_window)
        return *m_render_window;
    m_render_window = new RenderPictureWindow(this);
    m_render_window->setAttribute(Qt::WA_QuitOnClose, false);
    connect(m_render_window, &RenderPictureWindow::saveRequested, m_changes,
            [this] { m_changes->start("SaveRenderWindowAs"); });
    connect(m_render_window, &RenderPictureWindow::stopRequested, m_starter, &CommandStarter::stop);
    connect(m_render_window, &RenderPictureWindow::closedByPerson, m_starter,
            [this] { m_starter->start("_-CloseRenderWindow"); });
    return *m_render_window;
}

void MainWindow::showRenderedPicture(const ShownPicture& picture) {
    if (picture.width_px > 0 || m_render_window)
        renderWindow().showPicture(picture);
}

void MainWindow::showRenderProgress(double share) {
    m_animation->pictureRendered(share);
    if (share < 1.0 || m_render_window)
        renderWindow().showProgress(share);
}

/// The command that records succeeds wherever it came to its page; what counts is what there is.
void MainWindow::noteRecording(const RecordingReport& report) {
    const QString text = recordingText(report);
    m_pane->print(wideText(text + '\n').View());
    tell(text);
    m_lacks_files = m_lacks_files || !report.isComplete();
}

void MainWindow::noteSharedFile(const SharedFileReport& report) {
    m_pane->print(report.text.View());
    m_pane->print(L"\n");
    m_animation->sharedFileEnded(report);
    m_lacks_files = m_lacks_files || !report.is_made;
}

void MainWindow::tell(const QString& message) {
    statusBar()->showMessage(message, MESSAGE_MS);
}

void MainWindow::tellAndPrint(const QString& message) {
    tell(message);
    m_pane->print(message.toStdWString() + L'\n');
}

void MainWindow::runScript(const QString& file, bool wants_exit) {
    m_lacks_files = false;
    const bool has_succeeded = m_starter->startScript(file) && !m_lacks_files;
    if (wants_exit) // without the question about changes that closing the window asks
        QTimer::singleShot(0, qApp, [=] { QCoreApplication::exit(has_succeeded ? 0 : 1); });
}

void MainWindow::keepUnsavedWork(const RecoveryOptions& options) {
    m_recovery = new RecoveryBeat(m_session, *m_starter, options, this);
    m_recovery_offer = new RecoveryOffer(m_session, *m_starter, *m_changes, options, *this);
    connect(m_recovery, &RecoveryBeat::troubled, this, &MainWindow::tellAndPrint);
    connect(m_recovery_offer, &RecoveryOffer::nothingThere, this, &MainWindow::tell);
    connect(m_session_end, &SessionEnd::keepsWork, m_recovery, &RecoveryBeat::keepNow);
    m_menus->addBelow("Open", {&m_recovery_offer->action()});
}

void MainWindow::finish() {
    if (isVisible()) // nobody has closed it
        saveLayout();
    settleUnsavedWork();
}

void MainWindow::settleUnsavedWork() {
    if (!m_recovery)
        return;
    if (m_end->unsavedWork() == UnsavedWork::not_wanted) {
        m_recovery->forget();
        return;
    }
    allowSecondsToStop(LONGEST_KEEPING_S);
    m_recovery->keepNow();
}

void MainWindow::restoreLayout() {
    const QSettings settings;
    if (!restoreGeometry(settings.value(GEOMETRY).toByteArray()))
        resize(FIRST_SIZE.boundedTo(screen()->availableSize() - FRAME_ROOM));
    if (!restoreState(settings.value(PANELS).toByteArray(), PANELS_VERSION))
        resizeDocks({m_command_dock}, {FIRST_COMMAND_HEIGHT}, Qt::Vertical);
    m_views->grid().restoreBorders(settings.value(BORDERS).toByteArray());
}

void MainWindow::saveLayout() {
    QSettings settings;
    settings.setValue(GEOMETRY, saveGeometry());
    settings.setValue(PANELS, saveState(PANELS_VERSION));
    settings.setValue(BORDERS, m_views->grid().saveBorders());
}

void MainWindow::closeEvent(QCloseEvent* event) {
    if (!m_closing->mayClose()) {
        event->ignore();
        return;
    }
    saveLayout();
    if (m_render_window)
        m_render_window->hide();
    event->accept();
}

} // namespace quarn::desktop
