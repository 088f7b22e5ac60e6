#include "quarn/words/AnimationName.h"

#include "quarn/words/Words.h"
#include "sdk/qncore/QnAnimationName.h"

#include <algorithm>

namespace quarn::program {

namespace {

/// A browser reads these as parts of an address and would not find the pictures.
constexpr std::wstring_view FORBIDDEN_IN_ADDRESSES = L"#%";

/// Ten digits of a frame number, a point and an extension follow the name.
constexpr std::size_t LONGEST_NAME = LONGEST_FILE_NAME - 14;

bool isForbidden(wchar_t c) {
    return QnIsForbiddenInNames(c) || FORBIDDEN_IN_ADDRESSES.find(c) != std::wstring_view::npos ||
           QnIsControlCharacter(c);
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
    const std::wstring text = wideText(name);
    if (std::ranges::any_of(text, QnIsControlCharacter))
        return "--name must not hold line breaks or other control characters.";
    const auto forbidden = std::ranges::find_if(text, isForbidden);
    if (forbidden != text.end())
        return "--name must not hold " + utf8Text({&*forbidden, 1}) +
               "; the characters \\ | / : * ? \" < > # % cannot stand in the name of an animation.";
    if (!isUtf8(name))
        return "--name must be text in UTF-8.";
    if (name.size() > LONGEST_NAME)
        return "--name is too long for the name of a file; it may have " +
               std::to_string(LONGEST_NAME) + " bytes.";
    return std::nullopt;
}

std::string animationNameFor(const std::filesystem::path& model) {
    std::wstring text = wideText(model.stem().native());
    std::ranges::replace_if(text, isForbidden, L'_');
    std::string name = utf8Text(text);
    cutTo(LONGEST_NAME, name);
    return name.find_first_not_of(" \t") == std::string::npos ? "Animation" : name;
}

} // namespace quarn::program
