#include "tests/host/dialogs/DialogFixture.h"
#include "tests/host/dialogs/FogDialog.h"

using namespace quarn;
using namespace quarn::test;
using testing::HasSubstr;

namespace {

/// The fenced block of docs/dialogs.md in this language; there is one of each.
std::string blockOnThePage(const std::string& language) {
    const std::string page =
        readFile(std::filesystem::path(QUARN_SOURCE_DIR) / "docs" / "dialogs.md");
    const std::string fence = "```" + language + "\n";
    const std::size_t start = page.find(fence) + fence.size();
    return page.substr(start, page.find("```", start) - start);
}

class DialogsPage : public DialogTest {
protected:
    DialogsPage() { writeFile(folder / "300.dialog.json", blockOnThePage("json")); }
};

} // namespace

TEST_F(DialogsPage, ShowsTheClassThatIsCompiledHere) {
    const std::string compiled =
        readFile(std::filesystem::path(QUARN_SOURCE_DIR) / "tests/host/dialogs/FogDialog.h");
    EXPECT_EQ(compiled, "#pragma once\n\n" + blockOnThePage("cpp"));
}

TEST_F(DialogsPage, FormOnItTakesWhatIsEntered) {
    CFogDialog fog(nullptr);
    EXPECT_EQ(1, show(fog, [](HeadlessDialogWindow& window) {
                  EXPECT_EQ(L"Fog", window.form().title.View());
                  EXPECT_TRUE(window.form().controls.at(1).joins_row);
                  window.type(301, L"0,25");
                  window.pick(302, 1);
                  window.pressOk();
              }));
    EXPECT_EQ(0.25, fog.m_density);
    EXPECT_EQ(1, fog.m_color);
}

TEST_F(DialogsPage, FormOnItRefusesAsThePageSays) {
    CFogDialog fog(nullptr);
    show(fog, [](HeadlessDialogWindow& window) {
        window.type(301, L"1.5");
        window.pressOk();
        EXPECT_TRUE(window.isOpen());
        EXPECT_TRUE(window.click(303));
        EXPECT_EQ(L"0.5", window.text(301));
    });
    ASSERT_EQ(1U, front_end.messages().size());
    EXPECT_THAT(readFile(std::filesystem::path(QUARN_SOURCE_DIR) / "docs" / "dialogs.md"),
                HasSubstr("Enter a\nnumber between 0 and 1"));
    EXPECT_EQ(L"Enter a number between 0 and 1", front_end.messages()[0].text);
}
