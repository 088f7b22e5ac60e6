#include "tests/loader/LoaderTest.h"
#include "tests/support/TempFolder.h"

namespace quarn::test {
namespace {

namespace fs = std::filesystem;
using testing::HasSubstr;

/// A plug-in file of its own for each test, and templates wherever the test puts them.
class PlugInDialog : public LoaderTest {
protected:
    void SetUp() override {
        LoaderTest::SetUp();
        fs::create_directories(m_place / "plug-ins");
        fs::copy_file(folder() / "form.qnp", m_place / "plug-ins" / "form.qnp");
        SessionOptions options;
        options.language = "C";
        options.dialog_folders = {m_place / "share"};
        start(options);
        const PlugInLoad loaded = session->loadPlugIn(m_place / "plug-ins" / "form.qnp");
        ASSERT_TRUE(loaded.ok()) << loaded.message;
    }
    /// The folder is to be released before the file in it is deleted.
    void TearDown() override { session.reset(); }

    void writeTemplate(const fs::path& in_folder, const std::string& title) const {
        fs::create_directories(m_place / in_folder);
        writeFile(m_place / in_folder / "400.dialog.json",
                  R"({"id": 400, "title": {"text": ")" + title + R"("}, "controls": [
                      {"id": 401, "kind": "integer", "label": {"text": "Number"}}]})");
    }
    CQuarnCommand::result runInteractively() { return session->runCommand(L"TestForm", true); }
    /// The title of the form that the command shows.
    std::string shownTitle() {
        front_end.addDialog([](HeadlessDialogWindow& window) { window.pressOk(); });
        EXPECT_EQ(runInteractively(), CQuarnCommand::success) << printed();
        return front_end.dialogs().empty() ? "" : front_end.dialogs().back().title.ToUtf8();
    }

    TempFolder m_place;
};

TEST_F(PlugInDialog, IsAnsweredByAPersonWhileTheCommandRuns) {
    writeTemplate("share/form", "Form");
    front_end.addDialog([](HeadlessDialogWindow& window) {
        EXPECT_EQ(window.text(401), L"12");
        window.type(401, L"34");
        window.pressOk();
    });
    EXPECT_EQ(runInteractively(), CQuarnCommand::success);
    EXPECT_EQ(printed(), "It is 34\n");
}

TEST_F(PlugInDialog, ThatIsClosedCancelsTheCommand) {
    writeTemplate("share/form", "Form");
    front_end.addDialog(nullptr);
    EXPECT_EQ(runInteractively(), CQuarnCommand::cancel);
}

TEST_F(PlugInDialog, IsNotShownByAScriptedCommand) {
    writeTemplate("share/form", "Form");
    EXPECT_EQ(run(L"TestForm"), CQuarnCommand::nothing);
    EXPECT_TRUE(front_end.dialogs().empty());
}

TEST_F(PlugInDialog, HasItsTemplateBesideThePlugInBeforeThatOfTheSession) {
    writeTemplate("share/form", "Shared");
    EXPECT_EQ(shownTitle(), "Shared");
    writeTemplate("plug-ins/dialogs/form", "Beside");
    EXPECT_EQ(shownTitle(), "Beside");
}

TEST_F(PlugInDialog, DoesNotTakeTheTemplateOfAnotherPlugIn) {
    writeTemplate("share/other", "Other");
    EXPECT_EQ(runInteractively(), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("There is no dialog template 400.dialog.json in "));
    EXPECT_THAT(printed(), HasSubstr((m_place / "plug-ins" / "dialogs" / "form").native()));
}

} // namespace
} // namespace quarn::test
