#include "sdk/qncore/QnCommand.h"

#include "host/app/Application.h"
#include "host/app/PendingObjects.h"

CQuarnCommandContext::CQuarnCommandContext(CQuarnDoc& document, bool interactive)
    : m_document(&document), m_interactive(interactive) {}

CQuarnDoc& CQuarnCommandContext::Document() const {
    return *m_document;
}

bool CQuarnCommandContext::IsInteractive() const {
    return m_interactive;
}

CQuarnCommand::CQuarnCommand(bool transparent, bool do_not_repeat, const CQuarnPlugIn* plug_in,
                             bool hidden)
    : m_plug_in(plug_in), m_transparent(transparent), m_do_not_repeat(do_not_repeat),
      m_hidden(hidden) {
    quarn::PendingObjects::announce(*this);
}

CQuarnCommand::~CQuarnCommand() {
    quarn::PendingObjects::forget(*this);
    if (quarn::Application* application = quarn::Application::current())
        application->commands().remove(*this);
}

const wchar_t* CQuarnCommand::LocalCommandName() {
    return EnglishCommandName();
}

const wchar_t* CQuarnCommand::CommandDescription() {
    return L"";
}

CQuarnScriptCommand::CQuarnScriptCommand(bool transparent, bool do_not_repeat,
                                         const CQuarnPlugIn* plug_in, bool hidden)
    : CQuarnCommand(transparent, do_not_repeat, plug_in, hidden) {}

CQuarnScriptCommand::~CQuarnScriptCommand() = default;
