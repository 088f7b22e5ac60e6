#pragma once

#include <string>
#include <vector>

namespace quarn::test {

std::string withoutIndent(const std::string& line);

/// The lines of every fenced block of a page, without their indent, one list for each block.
/// @param page  its path from the project's root
std::vector<std::vector<std::string>> fencedBlocks(const std::string& page);

/// The words of a `quarn` command in a block, which has no quotes; nothing for any other line.
std::vector<std::string> argumentsOf(std::string line);

/// Every `quarn` command in the blocks of a page that starts with one of these words.
std::vector<std::vector<std::string>> commandsOn(const std::string& page,
                                                 const std::vector<std::string>& commands);

} // namespace quarn::test
