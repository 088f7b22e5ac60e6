#pragma once

#include <string>
#include <vector>

namespace quarn::test {

/// The commands of the program that have a help text of their own.
std::vector<std::string> subcommands();

/// What help prints: of a command, or of the program for an empty name.
std::string helpOf(const std::string& subcommand);

/// README.md, CONTRIBUTING.md and docs/*.md, by their paths from the project's root.
std::vector<std::string> pages();

/// A page, or the help text of a command, by its path or as "quarn COMMAND --help".
std::string printedText(const std::string& source);

/// Every line and every piece of inline code in a page that starts with one of these words, and
/// every such line of a help text.
std::vector<std::string> commandLines(const std::string& source,
                                      const std::vector<std::string>& starts);

/// The scripts of host commands that stand in a text, one after the other as one script.
std::string printedScript(const std::string& source);

/// The words of a line, as a shell splits them; what follows a ">" or a "|" is left off.
std::vector<std::string> shellWords(const std::string& line);

} // namespace quarn::test
