#include "tests/locale/SourceTexts.h"

#include "tests/locale/SourceTokens.h"
#include "tests/locale/TemplateTexts.h"

#include <algorithm>
#include <fstream>
#include <iterator>
#include <map>
#include <span>

namespace locale_rules {
namespace {

using Kind = Token::Kind;

bool isNumberOfText(const Token& token) {
    return token.kind == Kind::number && token.text.size() == 5 && token.text[0] != '0' &&
           std::ranges::all_of(token.text, [](char c) { return c >= '0' && c <= '9'; });
}

bool isSign(const Token& token, std::string_view sign) {
    return token.kind == Kind::sign && token.text == sign;
}

/// The texts of a file that have a name: `name = L"Text"` and `name[] = L"Text"`.
std::map<std::string, std::string> namedTexts(std::span<const Token> tokens) {
    std::map<std::string, std::string> texts;
    for (std::size_t i = 2; i < tokens.size(); ++i) {
        if (tokens[i].kind != Kind::wide_literal || !isSign(tokens[i - 1], "="))
            continue;
        std::size_t name = i - 2;
        if (name >= 2 && isSign(tokens[name], "]") && isSign(tokens[name - 1], "["))
            name -= 2;
        if (tokens[name].kind == Kind::word)
            texts[tokens[name].text] = tokens[i].text;
    }
    return texts;
}

/// The function whose arguments the last of these tokens stands among.
std::string calledAround(std::span<const Token> tokens) {
    int depth = 0;
    for (std::size_t i = tokens.size(); i-- > 1;) {
        if (isSign(tokens[i], ")") || isSign(tokens[i], "}"))
            ++depth;
        if (!isSign(tokens[i], "(") && !isSign(tokens[i], "{"))
            continue;
        if (depth-- == 0)
            return tokens[i - 1].kind == Kind::word ? tokens[i - 1].text : "";
    }
    return {};
}

std::optional<Space> spaceOfCall(std::string_view called) {
    if (called == "QnLocalizeString" || called == "localized")
        return Space::strings;
    if (called == "QnLocalizeCommandOptionName")
        return Space::option_names;
    if (called == "QnLocalizeCommandOptionValue")
        return Space::option_values;
    return {};
}

std::optional<std::string> englishBefore(const Token& token,
                                         const std::map<std::string, std::string>& named) {
    if (token.kind == Kind::wide_literal)
        return token.text;
    const auto found = token.kind == Kind::word ? named.find(token.text) : named.end();
    return found == named.end() ? std::nullopt : std::optional(found->second);
}

bool isSource(const std::filesystem::path& file) {
    const std::filesystem::path extension = file.extension();
    return extension == ".cpp" || extension == ".h" || extension == ".mm";
}

bool isTemplate(const std::filesystem::path& file) {
    return file.filename().string().ends_with(".dialog.json");
}

} // namespace

std::vector<TextUse> textUses(std::string_view source, const std::filesystem::path& file) {
    const std::vector<Token> tokens = tokensOf(source);
    const std::map<std::string, std::string> named = namedTexts(tokens);
    std::vector<TextUse> uses;
    for (std::size_t i = 2; i < tokens.size(); ++i) {
        if (!isNumberOfText(tokens[i]) || !isSign(tokens[i - 1], ","))
            continue;
        const auto space = spaceOfCall(calledAround(std::span(tokens).first(i)));
        const auto english = englishBefore(tokens[i - 2], named);
        if (space || english)
            uses.push_back({std::stoi(tokens[i].text), space, english, file, tokens[i].line});
    }
    return uses;
}

std::vector<TextUse> textUsesBelow(const std::filesystem::path& folder) {
    std::vector<TextUse> uses;
    for (const auto& entry : std::filesystem::recursive_directory_iterator(folder)) {
        if (!isSource(entry.path()) && !isTemplate(entry.path()))
            continue;
        std::ifstream stream(entry.path(), std::ios::binary);
        const std::string source{std::istreambuf_iterator<char>(stream), {}};
        std::ranges::move(isSource(entry.path()) ? textUses(source, entry.path())
                                                 : templateTextUses(source, entry.path()),
                          std::back_inserter(uses));
    }
    return uses;
}

} // namespace locale_rules
