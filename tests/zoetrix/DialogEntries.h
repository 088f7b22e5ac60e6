#pragma once

#include <optional>
#include <string>

/// What a person enters into a dialog of the test's dialog plug-in. What is not set is left as it
/// was shown.
struct Entered {
    std::optional<int> file_type = std::nullopt;
    std::optional<int> method = std::nullopt;
    std::optional<int> viewport = std::nullopt;
    std::optional<int> direction = std::nullopt;
    std::optional<int> frames = 12;
    std::optional<std::string> name = "Walk";
    /// In the dialogs of sun studies: latitude, longitude and north angle, with blanks between.
    std::optional<std::string> place = std::nullopt;
    /// Year, month, day, hour, minute and second, with blanks between.
    std::optional<std::string> start = std::nullopt;
    std::optional<std::string> end = std::nullopt;
    std::optional<int> minutes = std::nullopt;
    std::optional<int> days = std::nullopt;
    bool confirmed = true;
};

/// Has it entered into the next dialogs.
void enterIntoDialog(const Entered& entered);

/// What the last dialog showed when it opened, in the words of the test's dialog plug-in.
std::string shownInDialog();

/// What the last dialog of a sun study showed besides.
std::string sunShownInDialog();

/// Which dialog was the last: "turntable", "path", "day" or "season"; empty for none since
/// forgetDialog.
std::string shownDialog();
void forgetDialog();
