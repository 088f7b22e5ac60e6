#include "tests/host/app/TestCommand.h"
#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>

#include <chrono>
#include <cstdlib>
#include <fstream>
#include <thread>

namespace quarn::test {
namespace {

namespace fs = std::filesystem;
using testing::HasSubstr;
using testing::Not;

using HelpTest = HostTest;

TEST_F(HelpTest, ListsEveryCommandWithOneLine) {
    EXPECT_EQ(run(L"Help"), CQuarnCommand::success);
    EXPECT_THAT(printed(), HasSubstr("LoadPlugIn"));
    EXPECT_THAT(printed(), HasSubstr("Loads a plug-in file\n"));
    const auto lines = std::ranges::count(front_end.printed(), L'\n');
    EXPECT_EQ(static_cast<std::size_t>(lines), session.commandNames().size());
    EXPECT_TRUE(front_end.questions().empty());
}

TEST_F(HelpTest, TellsWhatOneCommandDoes) {
    EXPECT_EQ(run(L"Help exit"), CQuarnCommand::success);
    EXPECT_THAT(printed(), HasSubstr("Ends the program\n"));
    EXPECT_THAT(printed(), Not(HasSubstr("LoadPlugIn")));
    EXPECT_EQ(run(L"Help Nonsense"), CQuarnCommand::failure);
}

TEST_F(HelpTest, EveryHostCommandSaysWhatItDoes) {
    for (const RegisteredCommand& entry : Application::current()->commands().sortedByName())
        EXPECT_STRNE(entry.command->CommandDescription(), L"") << entry.english_name.ToUtf8();
}

TEST_F(HostTest, LoadPlugInTellsWhyAFileCannotBeLoaded) {
    EXPECT_EQ(run(L"LoadPlugIn no/such.qnp"), CQuarnCommand::failure);
    EXPECT_EQ(printed(), "There is no plug-in file no/such.qnp.\n");
}

/// Puts an opener of the test's own first in PATH.
class RunTest : public HostTest {
protected:
    void SetUp() override { std::ofstream(page) << "<html>"; }
    void TearDown() override { setenv("PATH", old_path.c_str(), 1); }

    void installOpener(const std::string& body) {
        const fs::path opener = folder / "xdg-open";
        std::ofstream(opener) << "#!/bin/sh\n" << body << "\n";
        fs::permissions(opener, fs::perms::owner_all);
        setenv("PATH", (folder.string() + ":" + old_path).c_str(), 1);
    }
    CQuarnCommand::result runOn(const fs::path& file) {
        return session.runCommand(L"Run \"" +
                                  std::wstring(KM_wString::FromUtf8(file.native()).View()) + L"\"");
    }

    const std::string old_path = std::getenv("PATH");
    const TempFolder folder_of_test;
    const fs::path folder = folder_of_test.path();
    const fs::path page = folder / "a page; touch pwned.html";
};

TEST_F(RunTest, HandsTheWholePathToTheOpenerWithoutAShell) {
    installOpener("printf '%s|' \"$#\" \"$1\" > '" + (folder / "seen").string() + "'");
    EXPECT_EQ(runOn(page), CQuarnCommand::success);
    std::ifstream seen(folder / "seen");
    std::string text;
    std::getline(seen, text);
    EXPECT_EQ(text, "1|" + page.string() + "|");
    EXPECT_EQ(printed(), "");
}

TEST_F(RunTest, AnOpenerThatGoesOnIsNotWaitedFor) {
    installOpener("exec sleep 5");
    const auto before = std::chrono::steady_clock::now();
    EXPECT_EQ(runOn(page), CQuarnCommand::success);
    EXPECT_LT(std::chrono::steady_clock::now() - before, std::chrono::seconds(4));
}

TEST_F(RunTest, AnOpenerThatFailsAtOnceIsTold) {
    installOpener("exit 3");
    EXPECT_EQ(runOn(page), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("xdg-open ended with code 3"));
}

TEST_F(RunTest, AMissingOpenerIsTold) {
    setenv("PATH", folder.c_str(), 1);
    EXPECT_EQ(runOn(page), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("xdg-open cannot be started"));
}

TEST_F(RunTest, AMissingFileIsTold) {
    installOpener("exit 0");
    EXPECT_EQ(runOn(folder / "missing.html"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("missing.html to open."));
}

} // namespace
} // namespace quarn::test
