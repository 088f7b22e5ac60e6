#include "tests/quarn/pages/PrintedCommands.h"

#include "tests/quarn/Pictures.h"
#include "tests/quarn/ProgramRun.h"
#include "tests/quarn/pages/DocsPage.h"

#include <algorithm>
#include <regex>

namespace quarn::test {

namespace {

const std::filesystem::path ROOT = QUARN_SOURCE_DIR;

bool isPage(const std::string& source) {
    return source.ends_with(".md");
}

/// The fenced lines of a page, or all lines of a help text, without their indent.
std::vector<std::string> plainLines(const std::string& source) {
    std::vector<std::string> lines;
    if (!isPage(source))
        for (const std::string& line : linesOf(printedText(source)))
            lines.push_back(withoutIndent(line));
    else
        for (const auto& block : fencedBlocks(source))
            lines.insert(lines.end(), block.begin(), block.end());
    return lines;
}

std::vector<std::string> inlineCode(const std::string& source) {
    if (!isPage(source))
        return {};
    static const std::regex code("`([^`\n]+)`");
    const std::string text = printedText(source);
    std::vector<std::string> pieces;
    for (std::sregex_iterator piece(text.begin(), text.end(), code), end; piece != end; ++piece)
        pieces.push_back((*piece)[1]);
    return pieces;
}

} // namespace

namespace {

/// "submit" behind "farm", and not what a person chooses, such as "MODEL".
bool isWord(const std::string& text) {
    return std::ranges::all_of(text, [](char c) { return c >= 'a' && c <= 'z'; });
}

} // namespace

std::vector<std::string> subcommands() {
    std::vector<std::string> names;
    for (const std::string& line : linesOf(run(std::vector<std::string>{}).err)) {
        const std::vector<std::string> words = shellWords(line);
        if (words.size() > 1 && words[0] == "quarn" && !words[1].starts_with('-') &&
            words[1] != "COMMAND")
            names.push_back(words.size() > 2 && isWord(words[2]) ? words[1] + " " + words[2]
                                                                 : words[1]);
    }
    return names;
}

std::string helpOf(const std::string& subcommand) {
    if (subcommand.empty())
        return run({"--help"}).out + run(std::vector<std::string>{}).err;
    std::vector<std::string> words = shellWords(subcommand);
    words.push_back("--help");
    return run(words).out;
}

std::vector<std::string> pages() {
    std::vector<std::string> found = {"README.md", "CONTRIBUTING.md"};
    for (const std::string& name : filesIn(ROOT / "docs"))
        if (name.ends_with(".md"))
            found.push_back("docs/" + name);
    return found;
}

std::string printedText(const std::string& source) {
    const std::vector<std::string> words = shellWords(source);
    if (words.front() != "quarn")
        return readFile(ROOT / source);
    const std::size_t start = source.find(' ') + 1;
    const std::size_t end = source.find("--help");
    return helpOf(end <= start ? "" : source.substr(start, end - start - 1));
}

std::vector<std::string> commandLines(const std::string& source,
                                      const std::vector<std::string>& starts) {
    std::vector<std::string> candidates = plainLines(source);
    for (const std::string& piece : inlineCode(source))
        candidates.push_back(piece);
    std::vector<std::string> found;
    for (std::string line : candidates) {
        if (line.starts_with("$ "))
            line.erase(0, 2);
        const bool is_command = std::ranges::any_of(
            starts, [&](const std::string& start) { return line.starts_with(start); });
        if (is_command)
            found.push_back(line);
    }
    return found;
}

std::string printedScript(const std::string& source) {
    std::string script;
    for (const std::string& line : plainLines(source))
        if (line.starts_with("_-"))
            script += line + "\n";
    return script;
}

std::vector<std::string> shellWords(const std::string& line) {
    static const std::regex word(R"rx("([^"]*)"|(\S+))rx");
    std::vector<std::string> words;
    for (std::sregex_iterator next(line.begin(), line.end(), word), end; next != end; ++next) {
        if (next->str() == ">" || next->str() == "|")
            break;
        words.push_back((*next)[1].matched ? (*next)[1].str() : (*next)[2].str());
    }
    return words;
}

} // namespace quarn::test
