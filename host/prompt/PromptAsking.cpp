#include "host/prompt/PromptAsking.h"

#include "host/app/Application.h"
#include "host/prompt/FrameCountAnswer.h"
#include "host/prompt/ObjectAnswer.h"
#include "host/prompt/OptionPick.h"
#include "host/prompt/PromptAnswer.h"
#include "sdk/qncore/QnLocalize.h"

namespace quarn {

namespace {

/// An answer and where it came from.
struct Reply {
    Answer answer;
    bool from_script = false;
    bool literal = false;
};

/// The answer that a word stands for.
Answer answerOf(const KM_wString& word) {
    if (word.CompareNoCase(L"_Enter") == 0)
        return {Answer::Kind::enter, {}};
    if (word.CompareNoCase(L"_Cancel") == 0)
        return {Answer::Kind::cancel, {}};
    return {Answer::Kind::text, word};
}

Reply takeWord(RunningCommand& command) {
    const CommandWord word = std::move(command.words.front());
    command.words.pop_front();
    const KM_wString text(std::wstring_view(word.text));
    if (word.quoted)
        return {{Answer::Kind::text, text}, true, true};
    return {answerOf(text), true, false};
}

/// Whether a person put all of an answer in quotes: an object's name or a path, as it stands in a
/// command line.
bool isQuoted(const Answer& answer) {
    const std::wstring_view text = answer.text.View();
    return answer.kind == Answer::Kind::text && text.size() > 2 && text.front() == L'"' &&
           text.find(L'"', 1) == text.size() - 1;
}

/// What a person says; an empty text is Enter.
Reply askPerson(Application& application, const PromptState& prompt) {
    Answer answer = application.frontEnd().ask(prompt.question());
    if (isQuoted(answer)) {
        const std::wstring_view text = answer.text.View();
        return {{Answer::Kind::text, text.substr(1, text.size() - 2)}, false, true};
    }
    if (answer.kind == Answer::Kind::text)
        answer = answer.text.IsEmpty() ? Answer{Answer::Kind::enter, {}} : answerOf(answer.text);
    return {std::move(answer), false, false};
}

Reply nextReply(Application& application, RunningCommand& command, const PromptState& prompt) {
    return command.words.empty() ? askPerson(application, prompt) : takeWord(command);
}

KM_wString label(const RunningCommand& command) {
    return std::wstring_view(command.label());
}

/// "Clockwise, AntiClockwise"
KM_wString optionNames(const PromptState& prompt) {
    KM_wString names;
    for (const PromptOption& option : prompt.options)
        names += (names.IsEmpty() ? L"" : L", ") + option.name.m_local;
    return names;
}

/// "SetTurntableAnimation needs an answer to "Direction" (Clockwise, AntiClockwise); none was
/// given."
void tellMissingAnswer(Application& application, const RunningCommand& command,
                       const PromptState& prompt) {
    KM_wString choices = optionNames(prompt);
    if (!choices.IsEmpty())
        choices = L" (" + choices + L")";
    const KM_wString message = label(command) + L" needs an answer to \"" + prompt.prompt + L"\"" +
                               choices + L"; none was given.\n";
    application.print(message.View());
}

void tellRefusal(Application& application, const RunningCommand& command, const Reply& reply,
                 const PromptState& prompt, const KM_wString& request) {
    KM_wString message = request + L".\n";
    if (reply.from_script) {
        const KM_wString word =
            reply.answer.kind == Answer::Kind::enter ? KM_wString(L"_Enter") : reply.answer.text;
        message = label(command) + L": \"" + word + L"\" does not answer \"" + prompt.prompt +
                  L"\". " + message;
    }
    application.print(message.View());
}

/// Whether a word that was taken as text was meant as an option: every text of a question for an
/// option, and one written as scripts write the English names of options of a question for text.
bool isMistakenForOption(const PromptState& prompt, const Reply& reply) {
    if (prompt.result != CQuarnGet::string || reply.answer.kind != Answer::Kind::text)
        return false;
    if (prompt.options.empty() || prompt.accepts_text || prompt.takes_points)
        return false;
    if (prompt.kind == Question::Kind::option)
        return true;
    const std::wstring_view word = reply.answer.text.View();
    return !reply.literal && word.starts_with(L'_') &&
           readOption(prompt, word).kind == OptionPick::Kind::none;
}

/// Tells that a word is no option. A question for text may understand more names than it offers, so
/// there the command decides.
void tellNoOption(Application& application, RunningCommand& command, const Reply& reply,
                  const PromptState& prompt) {
    KM_wString message = KM_wString::FormatToString(
        QnLocalizeString(L"\"%s\" is no option here. The options are %s.\n", 42110),
        reply.answer.text.Array(), optionNames(prompt).Array());
    if (reply.from_script)
        message = label(command) + L": " + message;
    if (prompt.kind == Question::Kind::option)
        application.print(message.View());
    else
        command.likely_mistake = message;
}

/// Takes an answer, if also the memory that it would ask for is there.
/// @return as takeAnswer
std::optional<KM_wString> takeReply(Application& application, const Reply& reply,
                                    PromptState& prompt) {
    std::optional<KM_wString> request = takeAnswer(prompt, reply.answer, reply.literal);
    const bool is_count =
        prompt.kind == Question::Kind::integer && prompt.result == CQuarnGet::number;
    if (request || !is_count)
        return request;
    request = refuseFrameCount(application, prompt.whole_number);
    if (request)
        prompt.result = CQuarnGet::no_result;
    return request;
}

CQuarnGet::result cancel(PromptState& prompt) {
    takeAnswer(prompt, {Answer::Kind::cancel, {}}, false);
    return prompt.result;
}

} // namespace

CQuarnGet::result askQuestion(PromptState& prompt, const char* call) {
    prompt.startAsking();
    Application* application = Application::forCall(call);
    if (!application)
        return prompt.result;
    RunningCommand* command = application->runner().current();
    if (!command) {
        reportBreach(call, "questions may be asked while a command runs");
        return prompt.result;
    }
    command->likely_mistake.Empty();
    if (takeSelection(prompt.objects)) {
        prompt.result = CQuarnGet::object;
        prompt.command_result = CQuarnCommand::success;
        return prompt.result;
    }
    while (prompt.result == CQuarnGet::no_result) {
        const Reply reply = nextReply(*application, *command, prompt);
        if (reply.answer.kind == Answer::Kind::nobody) {
            tellMissingAnswer(*application, *command, prompt);
            return cancel(prompt);
        }
        const std::optional<KM_wString> request = takeReply(*application, reply, prompt);
        if (!request && isMistakenForOption(prompt, reply))
            tellNoOption(*application, *command, reply, prompt);
        if (!request)
            continue;
        tellRefusal(*application, *command, reply, prompt, *request);
        if (reply.from_script && !command->typed)
            return cancel(prompt);
        command->words.clear(); // the next word would answer a question it was not written for
    }
    return prompt.result;
}

} // namespace quarn
