#include "host/commands/NumberPrompt.h"

#include "sdk/qncore/QnGet.h"

namespace quarn {

CQuarnCommand::result askNumber(const wchar_t* prompt, double lowest, double highest,
                                double& number) {
    CQuarnGetNumber get;
    get.SetCommandPrompt(prompt);
    get.SetLowerLimit(lowest);
    get.SetUpperLimit(highest);
    get.SetDefaultNumber(number);
    if (get.GetNumber() == CQuarnGet::number)
        number = get.Number();
    return get.CommandResult();
}

} // namespace quarn
