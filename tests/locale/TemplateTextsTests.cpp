#include "tests/locale/TemplateTexts.h"

#include <gtest/gtest.h>

namespace locale_rules {
namespace {

TEST(TemplateTexts, AreThoseOfTheTitleTheLabelsAndTheHints) {
    const std::vector<TextUse> uses = templateTextUses(R"({
    "id": 300, "title": {"text": "Fog", "id": 50001},
    "controls": [
        {"id": 301, "kind": "number", "label": {"text": "Density", "id": 50002},
         "hint": {"text": "How thick", "id": 50003}},
        {"id": 302, "kind": "text", "label": {"text": "Without a number"}}
    ]
})",
                                                       "300.dialog.json");
    ASSERT_EQ(3U, uses.size());
    EXPECT_EQ(50001, uses[0].number);
    EXPECT_EQ(Space::strings, uses[0].space);
    EXPECT_EQ("Fog", uses[0].english);
    EXPECT_EQ(2, uses[0].line);
    EXPECT_EQ("Density", uses[1].english);
    EXPECT_EQ(50003, uses[2].number);
    EXPECT_EQ(5, uses[2].line);
}

TEST(TemplateTexts, OfAFileThatIsNoJsonAreNone) {
    EXPECT_TRUE(templateTextUses("{", "300.dialog.json").empty());
}

} // namespace
} // namespace locale_rules
