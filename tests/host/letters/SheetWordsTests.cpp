#include "host/letters/SheetWords.h"

#include <gtest/gtest.h>

namespace quarn {
namespace {

TEST(SheetWords, ArgumentsStandInTheirPlacesAndAreNotLookedThrough) {
    EXPECT_EQ(SheetWords()({L"%2 of %1, 100 %, %3", 0}, {"a", "%1"}), "%1 of a, 100 %, %3");
}

TEST(SheetWords, DatesHaveTheirMonthInWords) {
    using namespace std::chrono;
    EXPECT_EQ(SheetWords().date(2026y / March / 21), "21 Mar 2026");
    EXPECT_EQ(SheetWords().date(December / 1), "1 Dec");
}

} // namespace
} // namespace quarn
