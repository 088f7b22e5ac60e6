#include "host/app/Application.h"
#include "host/commands/CommandEnd.h"
#include "host/commands/HostCommands.h"
#include "host/recording/FrameRanges.h"
#include "sdk/qncore/QnGet.h"
#include "sdk/qncore/QnLocalize.h"

namespace quarn {

namespace {

struct BeginOption {
    RecordingBegin begin;
    int index;
};

} // namespace

/// How the next recording begins, and which frames it makes; Enter ends the question.
CQuarnCommand::result runNextRecording(const CQuarnCommandContext&) {
    RecordingChoice choice;
    CQuarnGetOption get;
    get.SetCommandPrompt(QnLocalizeString(L"Frames of the next recording, such as 0-9", 42865));
    get.AcceptNothing();
    get.AcceptString();
    const auto add = [&](const wchar_t* name, int id, RecordingBegin begin) {
        return BeginOption{begin, get.AddCommandOption(QnLocalizeCommandOptionName(name, id))};
    };
    const BeginOption begins[] = {add(L"Anew", 42866, RecordingBegin::anew),
                                  add(L"IfSame", 42867, RecordingBegin::if_same),
                                  add(L"Resume", 42868, RecordingBegin::resume)};
    for (;;) {
        const CQuarnGet::result answer = get.GetOption();
        if (answer == CQuarnGet::nothing) {
            Application::current()->chooseNextRecording(std::move(choice));
            return CQuarnCommand::success;
        }
        if (answer == CQuarnGet::string) {
            auto frames = parseFrameRanges(KM_wString(get.String()).ToUtf8());
            if (!frames)
                return fail(frames.message());
            choice.frames = std::move(frames.value());
            continue;
        }
        if (answer != CQuarnGet::option)
            return get.CommandResult();
        for (const BeginOption& option : begins)
            if (get.Option()->m_option_index == option.index)
                choice.begin = option.begin;
    }
}

} // namespace quarn
