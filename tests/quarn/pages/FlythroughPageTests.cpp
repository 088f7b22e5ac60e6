#include "tests/quarn/Pictures.h"
#include "tests/quarn/Studio.h"
#include "tests/quarn/pages/DocsPage.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::SizeIs;

constexpr const char* PAGE = "docs/flythrough.md";

TEST(FlythroughPage, CurveFileOnItCanBeFlownAlong) {
    const Studio studio;
    std::string curve;
    for (const auto& block : fencedBlocks(PAGE))
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
    EXPECT_THAT(filesIn(studio / "walk"), SizeIs(6));
}

} // namespace
} // namespace quarn::test
