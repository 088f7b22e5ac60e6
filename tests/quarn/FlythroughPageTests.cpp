#include "tests/quarn/Pictures.h"
#include "tests/quarn/Recording.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <iterator>
#include <sstream>

namespace quarn::test {
namespace {

using testing::SizeIs;

std::string withoutIndent(const std::string& line) {
    const std::size_t first = line.find_first_not_of(' ');
    return first == std::string::npos ? std::string() : line.substr(first);
}

/// The lines of every fenced block of docs/flythrough.md, one list for each.
std::vector<std::vector<std::string>> blocksOfThePage() {
    std::vector<std::vector<std::string>> blocks;
    bool is_inside = false;
    for (const std::string& line :
         linesOf(readFile(std::filesystem::path(QUARN_SOURCE_DIR) / "docs/flythrough.md"))) {
        const std::string text = withoutIndent(line);
        if (text.starts_with("```")) {
            is_inside = !is_inside;
            if (is_inside)
                blocks.emplace_back();
        } else if (is_inside) {
            blocks.back().push_back(text);
        }
    }
    return blocks;
}

/// The words of a command line without quotes; nothing for a line that is no `quarn` command.
std::vector<std::string> argumentsOf(std::string line) {
    if (line.starts_with("$ "))
        line.erase(0, 2);
    if (!line.starts_with("quarn "))
        return {};
    std::istringstream words(line.substr(6));
    return {std::istream_iterator<std::string>(words), {}};
}

TEST(FlythroughPage, CurveFileOnItCanBeFlownAlong) {
    const Studio studio;
    std::string curve;
    for (const auto& block : blocksOfThePage())
        if (block.size() > 1 && block[1] == "degree 3")
            for (const std::string& line : block)
                curve += line + "\n";
    writeFile(studio / "walk.txt", curve);
    Start start;
    start.folder = studio.path();
    start.arguments = {"flythrough", "house.obj", "--camera-curve", "walk.txt", "--even-speed",
                       "--frames",   "3",         "--size",         "64x48",    "--out",
                       "walk"};
    const Ended ended = run(start);
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(filesIn(studio / "walk"), SizeIs(4));
}

TEST(FlythroughPage, EveryRecordingOnItIsTaken) {
    int recordings = 0;
    for (const auto& block : blocksOfThePage()) {
        for (const std::string& line : block) {
            std::vector<std::string> arguments = argumentsOf(line);
            if (arguments.empty() || (arguments[0] != "flythrough" && arguments[0] != "path"))
                continue;
            arguments.push_back("--show-script");
            const Ended ended = run(arguments);
            EXPECT_EQ(ended.exit_code, 0) << line << "\n" << ended.err;
            ++recordings;
        }
    }
    EXPECT_EQ(recordings, 6);
}

} // namespace
} // namespace quarn::test
