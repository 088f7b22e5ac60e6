#include "tests/zoetrix/DialogEntries.h"

#include <cstdlib>

namespace {

void setWish(const char* name, const std::optional<std::string>& wish) {
    const std::string variable = std::string("QUARN_DIALOG_") + name;
    if (wish)
        setenv(variable.c_str(), wish->c_str(), 1);
    else
        unsetenv(variable.c_str());
}

void setWish(const char* name, const std::optional<int>& wish) {
    setWish(name, wish ? std::optional(std::to_string(*wish)) : std::nullopt);
}

std::string told(const char* variable) {
    const char* words = std::getenv(variable);
    return words ? words : "";
}

} // namespace

void enterIntoDialog(const Entered& entered) {
    setWish("CONFIRM", std::optional<std::string>(entered.confirmed ? "1" : "0"));
    setWish("FILE_TYPE", entered.file_type);
    setWish("CAPTURE", entered.method);
    setWish("VIEWPORT", entered.viewport);
    setWish("DIRECTION", entered.direction);
    setWish("FRAMES", entered.frames);
    setWish("NAME", entered.name);
    setWish("PLACE", entered.place);
    setWish("START", entered.start);
    setWish("END", entered.end);
    setWish("MINUTES", entered.minutes);
    setWish("DAYS", entered.days);
}

std::string shownInDialog() {
    return told("QUARN_DIALOG_SHOWN");
}

std::string sunShownInDialog() {
    return told("QUARN_DIALOG_SUN");
}

std::string shownDialog() {
    return told("QUARN_DIALOG_KIND");
}

void forgetDialog() {
    unsetenv("QUARN_DIALOG_KIND");
    unsetenv("QUARN_DIALOG_SHOWN");
    unsetenv("QUARN_DIALOG_SUN");
}
