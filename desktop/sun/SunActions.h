#pragma once

#include "host/session/Session.h"

#include <QAction>
#include <QSize>
#include <QWidget>

#include <functional>

namespace quarn::desktop {

class CommandStarter;
class DesktopFrontEnd;
struct SunOffer;

/// What a person wants to know of the sun without setting up an animation: the hours of it that
/// surfaces get, the diagram of its paths, where it stands. Each begins with its form.
///
/// The actions are called `sunHours`, `sunPath` and `sunAlmanac`.
class SunActions final : public QObject {
    Q_OBJECT
public:
    /// All must outlive this. @param window  forms stand before it
    SunActions(Session& session, DesktopFrontEnd& front_end, CommandStarter& starter,
               QWidget& window);

    /// In the order of the menu.
    const QList<QAction*>& actions() const { return m_actions; }

private:
    void add(const char* name, const QString& text, const QString& tip, void (SunActions::*act)());
    SunOffer offer() const;
    void askHours();
    void askPath();
    void askAlmanac();
    /// Does it as a command is done, and tells the person how it ended.
    void make(const QString& name, const std::function<CQuarnCommand::result()>& work);
    CQuarnCommand::result fail(const std::filesystem::path& file, const std::string& why);

    Session& m_session;
    DesktopFrontEnd& m_front_end;
    CommandStarter& m_starter;
    QWidget& m_window;
    QList<QAction*> m_actions;
};

} // namespace quarn::desktop
