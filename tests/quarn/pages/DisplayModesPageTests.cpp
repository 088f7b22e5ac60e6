#include "tests/quarn/Pictures.h"
#include "tests/quarn/Studio.h"
#include "tests/quarn/pages/DocsPage.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

constexpr const char* PAGE = "docs/display-modes.md";

TEST(DisplayModesPage, EdgesChosenByItsScriptAreInTheFramesRecordedLater) {
    const Studio studio;
    std::string script;
    for (const auto& block : fencedBlocks(PAGE))
        if (block.size() > 3 && block[1] == "_-DisplayMode _Shaded")
            for (const std::string& line : block)
                script += (line == "_-Open \"house.glb\"" ? "_-Open \"house.obj\"" : line) + "\n";
    ASSERT_FALSE(script.empty());
    writeFile(studio / "edges.txt", script);
    const auto recorded = [&](const char* model, const char* folder) {
        Start start;
        start.folder = studio.path();
        start.arguments = {"turntable", model,    "--frames", "1",    "--size",   "96x64",
                           "--mode",    "Shaded", "--out",    folder, "--format", "bmp"};
        const Ended ended = run(start);
        EXPECT_EQ(ended.exit_code, 0) << ended.err;
        for (const std::string& name : filesIn(studio / folder))
            if (name.ends_with(".bmp"))
                return readBitmap(studio / folder / name);
        return Picture();
    };
    Start start;
    start.folder = studio.path();
    start.arguments = {"run", "edges.txt"};
    const Ended ended = run(start);
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    const Picture plain = recorded("house.obj", "plain");
    const Picture edges = recorded("house.quarn", "edges");
    ASSERT_EQ(plain.width_px, 96);
    EXPECT_GT(meanDifference(plain, edges), 0.005);
}

} // namespace
} // namespace quarn::test
