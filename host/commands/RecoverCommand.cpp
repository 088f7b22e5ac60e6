#include "host/app/Application.h"
#include "host/commands/CommandEnd.h"
#include "host/commands/HostCommands.h"
#include "host/front_end/StateFolder.h"
#include "host/recovery/RecoverableDocuments.h"
#include "host/recovery/RecoveryMarks.h"
#include "sdk/qncore/QnGet.h"

namespace quarn {

namespace {

/// What a person wants to have done with which document.
struct Wish {
    CQuarnCommand::result result = CQuarnCommand::success;
    int number = 1; ///< of the document, from 1
    bool is_to_discard = false;
};

Wish askWish(int count) {
    Wish wish;
    for (;;) {
        CQuarnGetInteger get;
        get.SetCommandPrompt(wish.is_to_discard
                                 ? QnLocalizeString(L"Number of the document to discard", 42572)
                                 : QnLocalizeString(L"Number of the document to recover", 42571));
        get.SetDefaultInteger(1);
        get.SetLowerLimit(1);
        get.SetUpperLimit(count);
        if (!wish.is_to_discard)
            get.AddCommandOption(QnLocalizeCommandOptionName(L"Discard", 42570));
        const CQuarnGet::result answer = get.GetNumber();
        wish.number = get.Number();
        wish.result = get.CommandResult();
        if (answer != CQuarnGet::option)
            return wish;
        wish.is_to_discard = true;
    }
}

CQuarnCommand::result recoverNow(Application& application, const RecoverableDocument& document) {
    const auto opened = openRecovered(application.documents(), document);
    if (!opened)
        return fail(opened.message());
    for (const std::string& line : opened.value())
        application.tell(line);
    return CQuarnCommand::success;
}

} // namespace

CQuarnCommand::result runRecover(const CQuarnCommandContext&) {
    Application& application = *Application::current();
    const std::vector<RecoverableDocument> documents = recoverableIn(userStateFolder());
    if (documents.empty())
        return fail("There is no unsaved document to recover.");
    for (std::size_t i = 0; i < documents.size(); ++i)
        application.tell(std::to_string(i + 1) + ": " + textOf(documents[i]));
    const Wish wish = askWish(static_cast<int>(documents.size()));
    if (wish.result != CQuarnCommand::success)
        return wish.result;
    const RecoverableDocument& chosen = documents[static_cast<std::size_t>(wish.number - 1)];
    if (!wish.is_to_discard)
        return recoverNow(application, chosen);
    removeRecovery(chosen.mark);
    application.tell("Discarded " + textOf(chosen) + ".");
    return CQuarnCommand::success;
}

} // namespace quarn
