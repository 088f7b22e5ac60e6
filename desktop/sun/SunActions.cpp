#include "desktop/sun/SunActions.h"

#include "desktop/command_line/CommandStarter.h"
#include "desktop/front_end/DesktopFrontEnd.h"
#include "desktop/sun/AlmanacForm.h"
#include "desktop/sun/HoursForm.h"
#include "desktop/sun/PathForm.h"
#include "desktop/texts/Texts.h"
#include "host/session/DocumentState.h"
#include "host/session/ViewFrame.h"
#include "sdk/qncore/QnView.h"

#include <QPointer>

#include <algorithm>
#include <cmath>

namespace quarn::desktop {

namespace {

QSize pictureSizeOf(CQuarnView& view) {
    int width_px = 0;
    int height_px = 0;
    view.MainViewport().VP().GetScreenPort(&width_px, &height_px);
    return {width_px, height_px};
}

/// "11 h 50 min"
QString hoursText(double hours) {
    const long minutes = std::lround(60.0 * hours);
    return localized(L"%1 h %2 min", 45232).arg(minutes / 60).arg(minutes % 60);
}

KM_wString toldHours(const std::filesystem::path& page, const SunHoursFiles& made, int step) {
    if (made.steps == 0)
        return wideText(
            localized(L"%1: the sun does not rise there in this time, all hours are 0.", 45581)
                .arg(qtText(page)));
    return wideText(localized(L"%1: at most %2 of sun a day, in steps of %3 min.", 45582)
                        .arg(qtText(page), hoursText(made.most_hours), QString::number(step)));
}

std::filesystem::path pageOf(const SunHoursFiles& made) {
    const auto page = std::ranges::find_if(
        made.files, [](const std::filesystem::path& file) { return file.extension() == ".html"; });
    return page == made.files.end() ? made.files.front() : *page;
}

/// Shows a form. @return whether it was taken
template <class Form> bool isTaken(const QPointer<Form>& form) {
    const bool is_taken = form->exec() == QDialog::Accepted;
    return form && is_taken;
}

} // namespace

SunActions::SunActions(Session& session, DesktopFrontEnd& front_end, CommandStarter& starter,
                       QWidget& window)
    : QObject(&window), m_session(session), m_front_end(front_end), m_starter(starter),
      m_window(window) {
    add("sunHours", localized(L"&Hours of sun…", 45583),
        localized(L"How many hours of direct sun each place of the model gets, as a picture",
                  45584),
        &SunActions::askHours);
    add("sunPath", localized(L"Sun &path diagram…", 45585),
        localized(L"The ways of the sun through the year, and what hides them", 45586),
        &SunActions::askPath);
    add("sunAlmanac", localized(L"&Where the sun stands…", 45587),
        localized(L"Sunrise, sunset and the place of the sun at each hour of a day", 45588),
        &SunActions::askAlmanac);
    connect(&starter, &CommandStarter::started, this, [this] {
        for (QAction* const action : m_actions)
            action->setEnabled(false);
    });
    connect(&starter, &CommandStarter::ended, this, [this] {
        for (QAction* const action : m_actions)
            action->setEnabled(true);
    });
}

void SunActions::add(const char* name, const QString& text, const QString& tip,
                     void (SunActions::*act)()) {
    auto* const action = new QAction(text, this);
    action->setObjectName(name);
    action->setToolTip(tip);
    action->setStatusTip(tip);
    connect(action, &QAction::triggered, this, act);
    m_actions << action;
}

SunOffer SunActions::offer() const {
    CQuarnDoc& document = m_session.document();
    const std::string stem = documentFile(document).stem().string();
    return {studiedSite(document), stem.empty() ? "model" : stem, firstFolder(),
            pictureSizeOf(activeView(document))};
}

void SunActions::askHours() {
    const QPointer<HoursForm> form(new HoursForm(offer(), &m_window));
    if (!isTaken(form)) {
        delete form;
        return;
    }
    const SunHoursRequest wish = form->request();
    keepStudiedSite(m_session.document(), form->site());
    delete form;
    make("SunHours", [this, wish] {
        const std::filesystem::path first = wish.folder / (wish.name + "-sunhours.png");
        const auto made = makeSunHours(m_session.document(), wish, [&](double share) {
            m_front_end.sharedFileProgress(first, share);
            m_front_end.pumpEvents(0);
            return !m_front_end.isInterrupted();
        });
        if (!made)
            return fail(first, made.message());
        const SunHoursFiles& files = made.value();
        if (files.is_given_up)
            return CQuarnCommand::cancel;
        const std::filesystem::path page = pageOf(files);
        m_front_end.sharedFileEnded(
            {page, true, toldHours(page, files, wish.every_minutes), files.files.front()});
        return CQuarnCommand::success;
    });
}

void SunActions::askPath() {
    const QPointer<PathForm> form(new PathForm(offer(), &m_window));
    if (!isTaken(form)) {
        delete form;
        return;
    }
    const SunPathRequest wish = form->request();
    keepStudiedSite(m_session.document(), form->site());
    delete form;
    make("SunPath", [this, wish] {
        const auto drawn = makeSunPath(m_session.document(), wish);
        if (!drawn)
            return fail(wish.file, drawn.message());
        const QString told =
            localized(L"%1: hours are those of %2.", 45589)
                .arg(qtText(wish.file), QString::fromStdString(drawn.value().clock_name));
        m_front_end.sharedFileEnded({wish.file, true, wideText(told), wish.file});
        return CQuarnCommand::success;
    });
}

void SunActions::askAlmanac() {
    const QPointer<AlmanacForm> form(new AlmanacForm(offer().site, &m_window));
    form->exec();
    delete form;
}

void SunActions::make(const QString& name, const std::function<CQuarnCommand::result()>& work) {
    m_starter.startWork(name, work);
}

CQuarnCommand::result SunActions::fail(const std::filesystem::path& file, const std::string& why) {
    m_front_end.sharedFileEnded({file, false, KM_wString::FromUtf8(why), {}});
    return CQuarnCommand::failure;
}

} // namespace quarn::desktop
