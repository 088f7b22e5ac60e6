#include "host/share/viewer/PageTemplate.h"
#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::HasSubstr;

std::span<const std::byte> bytesOf(std::string_view text) {
    return std::as_bytes(std::span(text));
}

class PageTemplateTest : public testing::Test {
protected:
    Result<std::string> fill(const PlaceFillers& fillers) {
        std::string text;
        const auto filled =
            fillTemplate(m_folder / "page.html", fillers, [&](std::span<const std::byte> bytes) {
                text.append(reinterpret_cast<const char*>(bytes.data()), bytes.size());
                return true;
            });
        if (!filled)
            return filled.error();
        return text;
    }

    TempFolder m_folder;
};

TEST_F(PageTemplateTest, FillsPlacesAndTakesInFiles) {
    writeFile(m_folder / "page.html", "<b>{{name}}</b>{{file:look.css}}{{name}}.");
    writeFile(m_folder / "look.css", "b{}");
    const auto text = fill({{"name", [](const ByteSink& sink) { put(sink, "A"); }}});
    ASSERT_TRUE(text) << text.message();
    EXPECT_EQ(text.value(), "<b>A</b>b{}A.");
}

TEST_F(PageTemplateTest, DoesNotLookThroughWhatCameIntoAPlace) {
    writeFile(m_folder / "page.html", "{{name}}");
    const auto text = fill({{"name", [](const ByteSink& sink) { put(sink, "{{name}} {{x}}"); }}});
    ASSERT_TRUE(text) << text.message();
    EXPECT_EQ(text.value(), "{{name}} {{x}}");
}

TEST_F(PageTemplateTest, NamesTheFileOrThePlaceThatIsMissing) {
    writeFile(m_folder / "page.html", "{{file:gone.js}}");
    EXPECT_THAT(fill({}).message(), HasSubstr("gone.js"));
    writeFile(m_folder / "page.html", "{{unknown}}");
    EXPECT_THAT(fill({}).message(), HasSubstr("{{unknown}}"));
}

// RFC 4648, section 10.
TEST(Base64, IsThatOfItsTestVectors) {
    EXPECT_EQ(base64(bytesOf("")), "");
    EXPECT_EQ(base64(bytesOf("f")), "Zg==");
    EXPECT_EQ(base64(bytesOf("fo")), "Zm8=");
    EXPECT_EQ(base64(bytesOf("foo")), "Zm9v");
    EXPECT_EQ(base64(bytesOf("foob")), "Zm9vYg==");
    EXPECT_EQ(base64(bytesOf("fooba")), "Zm9vYmE=");
    EXPECT_EQ(base64(bytesOf("foobar")), "Zm9vYmFy");
    EXPECT_EQ(base64(bytesOf("\xFB\xFF\xFE")), "+//+");
}

TEST(TextsInPages, CannotEndWhatTheyStandIn) {
    EXPECT_EQ(htmlText("<a href=\"x\">&"), "&lt;a href=&quot;x&quot;&gt;&amp;");
    EXPECT_EQ(jsonInHtml(R"({"a":"</script><!--"})"), R"({"a":"\u003c/script>\u003c!--"})");
    EXPECT_EQ(addressOf("a b#%?\"'/\xC3\xA9-1.jpg"), "a%20b%23%25%3F%22%27%2F%C3%A9-1.jpg");
}

} // namespace
} // namespace quarn::test
