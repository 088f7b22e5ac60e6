#include "quarn/words/AnimationName.h"

#include "quarn/words/Words.h"
#include "sdk/qncore/QnAnimationName.h"

#include <algorithm>

namespace quarn::program {

namespace {

/// A browser reads these as parts of an address and would not find the pictures.
constexpr std::string_view FORBIDDEN_IN_ADDRESSES = "#%";

/// Ten digits of a frame number, a point and an extension follow the name.
constexpr std::size_t LONGEST_NAME = LONGEST_FILE_NAME - 14;

bool isForbidden(char c) {
    return QnIsForbiddenInNames(static_cast<unsigned char>(c)) ||
           FORBIDDEN_IN_ADDRESSES.find(c) != std::string_view::npos || hasControlCharacter({&c, 1});
}

/// Cuts text in UTF-8 between two characters.
void cutTo(std::size_t length, std::string& text) {
    constexpr auto is_continuation = [](char c) { return (c & 0xC0) == 0x80; };
    if (text.size() <= length)
        return;
    while (length > 0 && is_continuation(text[length]))
        --length;
    text.resize(length);
}

} // namespace

std::optional<std::string> whyNameIsRefused(const std::string& name) {
    if (name.find_first_not_of(" \t") == std::string::npos)
        return "--name must not be empty.";
    if (hasControlCharacter(name))
        return "--name must not hold line breaks or other control characters.";
    const auto forbidden = std::find_if(name.begin(), name.end(), isForbidden);
    if (forbidden != name.end())
        return "--name must not hold " + std::string(1, *forbidden) +
               "; the characters \\ | / : * ? \" < > # % cannot stand in the name of an animation.";
    if (!isUtf8(name))
        return "--name must be text in UTF-8.";
    if (name.size() > LONGEST_NAME)
        return "--name is too long for the name of a file; it may have " +
               std::to_string(LONGEST_NAME) + " bytes.";
    return std::nullopt;
}

std::string animationNameFor(const std::filesystem::path& model) {
    std::string name = model.stem().native();
    std::replace_if(name.begin(), name.end(), isForbidden, '_');
    cutTo(LONGEST_NAME, name);
    return name.find_first_not_of(" \t") == std::string::npos ? "Animation" : name;
}

} // namespace quarn::program
