#include "host/commands/ObjectPicking.h"

#include "host/commands/WordsLeft.h"

namespace quarn {

namespace {

PickedObjects pickedBy(const CQuarnGetObject& get) {
    PickedObjects picked{get.CommandResult(), {}};
    for (int i = 0; i < get.ObjectCount(); ++i)
        picked.ids.push_back(get.Object(i).ObjectUuid());
    return picked;
}

PickedObjects askSelectionOrPerson(const wchar_t* prompt) {
    CQuarnGetObject get;
    get.SetCommandPrompt(prompt);
    get.EnablePreSelect(true, false);
    get.GetObjects(1, 0);
    return pickedBy(get);
}

/// One pick a word: the end of the line ends the objects as Enter does.
PickedObjects askWords(const wchar_t* prompt) {
    PickedObjects picked{CQuarnCommand::success, {}};
    do {
        CQuarnGetObject get;
        get.SetCommandPrompt(prompt);
        get.AcceptNothing(!picked.ids.empty());
        const CQuarnGet::result answer = get.GetObjects(1, 1);
        if (answer == CQuarnGet::nothing)
            return picked;
        if (answer != CQuarnGet::object)
            return {get.CommandResult(), {}};
        picked.ids.push_back(get.Object(0).ObjectUuid());
    } while (hasWordsLeft());
    return picked;
}

} // namespace

PickedObjects askObjects(const wchar_t* prompt) {
    return hasWordsLeft() ? askWords(prompt) : askSelectionOrPerson(prompt);
}

std::string objectCountText(std::size_t count) {
    return std::to_string(count) + (count == 1 ? " object" : " objects");
}

} // namespace quarn
