#include "host/letters/Letters.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn {
namespace {

using testing::AllOf;
using testing::HasSubstr;

Letters letters() {
    return Letters::read(programFont()).value();
}

TEST(Letters, FontThatIsMissingOrIsNoneIsNamed) {
    const auto missing = Letters::read("/nowhere/letters.ttf");
    ASSERT_FALSE(missing);
    EXPECT_THAT(missing.message(), AllOf(HasSubstr("/nowhere/letters.ttf"), HasSubstr("Install")));
    const auto none = Letters::read(QUARN_SOURCE_DIR "/README.md");
    ASSERT_FALSE(none);
    EXPECT_THAT(none.message(), AllOf(HasSubstr("README.md is no font"), HasSubstr("Install")));
}

TEST(Letters, KnowWhichTextsTheyCannotWrite) {
    EXPECT_TRUE(letters().have("21 März, 11 h"));
    EXPECT_FALSE(letters().have("21 日"));
}

struct Box {
    double left, right, top, bottom;
};

Box boxOf(const std::vector<std::vector<LetterPoint>>& outlines) {
    Box box{1e9, -1e9, 1e9, -1e9};
    for (const auto& outline : outlines)
        for (const LetterPoint& point : outline)
            box = {std::min(box.left, point.x_px), std::max(box.right, point.x_px),
                   std::min(box.top, point.y_px), std::max(box.bottom, point.y_px)};
    return box;
}

// The capital H of the font is 1493 units high, of 2048 of the em square.
TEST(Letters, OutlinesStandOnTheLineAndGrowWithTheSize) {
    const Box box = boxOf(letters().outlines("HH", 100));
    EXPECT_NEAR(box.top, -100.0 * 1493 / 2048, 0.01);
    EXPECT_NEAR(box.bottom, 0, 0.01);
    EXPECT_GT(box.left, 0);
    EXPECT_LT(box.right, letters().width("HH", 100));
    EXPECT_NEAR(letters().width("HH", 100, 3), letters().width("HH", 100) + 6, 1e-9);
}

TEST(Letters, ShadesCoverWhatTheOutlinesEnclose) {
    const Box box = boxOf(letters().outlines("H", 40));
    Box shaded{1e9, -1e9, 1e9, -1e9};
    letters().shade("H", 40, 7, 50, [&](int x, int y, double share) {
        if (share > 0)
            shaded = {std::min(shaded.left, double(x)), std::max(shaded.right, x + 1.0),
                      std::min(shaded.top, double(y)), std::max(shaded.bottom, y + 1.0)};
    });
    EXPECT_NEAR(shaded.left, 7 + box.left, 1);
    EXPECT_NEAR(shaded.right, 7 + box.right, 1);
    EXPECT_NEAR(shaded.top, 50 + box.top, 1);
    EXPECT_NEAR(shaded.bottom, 50, 1);
}

} // namespace
} // namespace quarn
