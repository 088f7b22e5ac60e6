#include "sdk/qncore/QnApp.h"
#include "sdk/qncore/QnDoc.h"
#include "sdk/qncore/QnGet.h"
#include "tests/host/app/TestCommand.h"
#include "tests/host/border/BreachList.h"
#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>

#include <fstream>
#include <stdexcept>

namespace quarn::test {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;

class CommandRunnerTest : public HostTest {
protected:
    /// Writes a script and runs it.
    std::optional<std::string> runScript(const std::string& bytes) {
        const TempFolder folder;
        const std::filesystem::path file = folder / "steps.txt";
        std::ofstream(file, std::ios::binary) << bytes;
        return session.runScriptFile(file);
    }

    TestCommand good{L"Good", [this](const CQuarnCommandContext& context) {
                         ++good_runs;
                         was_interactive = context.IsInteractive();
                         return CQuarnCommand::success;
                     }};
    TestCommand bad{L"Bad", [](const CQuarnCommandContext&) { return CQuarnCommand::failure; }};
    int good_runs = 0;
    bool was_interactive = false;

    void SetUp() override {
        add(good);
        add(bad);
    }
};

// ---- One line

TEST_F(CommandRunnerTest, ACommandIsFoundByItsNameInAnyCase) {
    EXPECT_EQ(run(L"good"), CQuarnCommand::success);
    EXPECT_EQ(run(L"_GOOD"), CQuarnCommand::success);
    EXPECT_EQ(good_runs, 2);
}

TEST_F(CommandRunnerTest, ALocalNameIsNoEnglishName) {
    TestCommand local(L"Local", [](const CQuarnCommandContext&) { return CQuarnCommand::success; });
    local.m_local_name = L"Örtlich";
    add(local);
    EXPECT_EQ(run(L"örtlich"), CQuarnCommand::success);
    EXPECT_EQ(run(L"_örtlich"), CQuarnCommand::failure);
    EXPECT_EQ(run(L"_Local"), CQuarnCommand::success);
}

TEST_F(CommandRunnerTest, AnUnknownCommandIsToldAndFails) {
    EXPECT_EQ(run(L"_-Rendre x"), CQuarnCommand::failure);
    EXPECT_EQ(printed(), "Unknown command: Rendre. Type Help for the list.\n");
}

TEST_F(CommandRunnerTest, ABlankLineSucceeds) {
    EXPECT_EQ(run(L"  "), CQuarnCommand::success);
    EXPECT_EQ(printed(), "");
}

TEST_F(CommandRunnerTest, WordsThatWereNotUsedAreTold) {
    EXPECT_EQ(run(L"Good 5 Clockwise"), CQuarnCommand::success);
    EXPECT_EQ(printed(), "Good did not use: 5 Clockwise\n");
}

TEST_F(CommandRunnerTest, OnlyAPersonInAWindowIsInteractive) {
    session.runCommand(L"Good", true);
    EXPECT_TRUE(was_interactive);
    session.runCommand(L"-Good", true);
    EXPECT_FALSE(was_interactive);
    session.runCommand(L"Good", false);
    EXPECT_FALSE(was_interactive);
}

TEST_F(CommandRunnerTest, WhatACommandThrowsIsToldAndFails) {
    TestCommand words(L"Words", [](const CQuarnCommandContext&) -> CQuarnCommand::result {
        throw std::runtime_error("no more clay");
    });
    TestCommand number(L"Number",
                       [](const CQuarnCommandContext&) -> CQuarnCommand::result { throw 5; });
    add(words);
    add(number);
    EXPECT_EQ(run(L"Words"), CQuarnCommand::failure);
    EXPECT_EQ(run(L"Number"), CQuarnCommand::failure);
    EXPECT_EQ(printed(), "Words stopped with an error: no more clay\n"
                         "Number stopped with an error: unknown error\n");
    EXPECT_EQ(run(L"Good"), CQuarnCommand::success);
}

TEST_F(CommandRunnerTest, NoCommandStartsWhileAnotherRuns) {
    CQuarnCommand::result inner = CQuarnCommand::success;
    TestCommand outer(L"Outer", [&](const CQuarnCommandContext&) {
        inner = session.runCommand(L"Good");
        return CQuarnCommand::success;
    });
    add(outer);
    run(L"Outer");
    EXPECT_EQ(inner, CQuarnCommand::failure);
    EXPECT_EQ(good_runs, 0);
    EXPECT_EQ(printed(), "Outer is running; wait until it has ended.\n");
}

// ---- Scripts of commands

TEST_F(CommandRunnerTest, AScriptCommandRunsOthersWithTheirOwnWords) {
    std::wstring inner_answer;
    std::wstring outer_answer;
    TestCommand inner(L"Inner", [&](const CQuarnCommandContext& context) {
        EXPECT_FALSE(context.IsInteractive());
        CQuarnGetString get;
        get.GetString();
        inner_answer = get.String();
        return CQuarnCommand::success;
    });
    TestScriptCommand outer(L"Outer", [&](const CQuarnCommandContext& context) {
        const unsigned int document = context.Document().RuntimeSerialNumber();
        EXPECT_TRUE(QuarnApp().RunScript(document, L"! _Inner \"its own\" ", 1));
        EXPECT_TRUE(QuarnApp().RunScript(document, L"_Good", 0));
        EXPECT_FALSE(QuarnApp().RunScript(document, L"_Bad", 0));
        EXPECT_FALSE(QuarnApp().RunScript(document, L"_Missing", 0));
        CQuarnGetString get;
        get.GetString();
        outer_answer = get.String();
        return CQuarnCommand::success;
    });
    add(inner);
    add(outer);
    EXPECT_EQ(session.runCommand(L"Outer kept", true), CQuarnCommand::success);
    EXPECT_EQ(inner_answer, L"its own");
    EXPECT_EQ(outer_answer, L"kept");
    EXPECT_EQ(printed(), "Command: ! _Inner \"its own\" \n"
                         "Unknown command: Missing. Type Help for the list.\n");
}

TEST_F(CommandRunnerTest, AnOrdinaryCommandMayRunNoScript) {
    bool ran = true;
    TestCommand ordinary(L"Ordinary", [&](const CQuarnCommandContext& context) {
        ran = QuarnApp().RunScript(context.Document().RuntimeSerialNumber(), L"Good", 0);
        return CQuarnCommand::success;
    });
    add(ordinary);
    BreachList breaches;
    run(L"Ordinary");
    EXPECT_FALSE(ran);
    EXPECT_EQ(good_runs, 0);
    EXPECT_THAT(breaches.take(), ElementsAre("CQuarnApp::RunScript: only a running "
                                             "CQuarnScriptCommand may call it"));
}

TEST_F(CommandRunnerTest, NoScriptRunsOutsideACommandOrInADocumentThatIsNotOpen) {
    BreachList breaches;
    EXPECT_FALSE(QuarnApp().RunScript(session.document().RuntimeSerialNumber(), L"Good", 0));
    EXPECT_THAT(breaches.take(), ElementsAre("CQuarnApp::RunScript: only a running "
                                             "CQuarnScriptCommand may call it"));
    bool ran = true;
    TestScriptCommand outer(L"Outer", [&](const CQuarnCommandContext&) {
        ran = QuarnApp().RunScript(0, L"Good", 0);
        return CQuarnCommand::success;
    });
    add(outer);
    run(L"Outer");
    EXPECT_FALSE(ran);
    EXPECT_EQ(good_runs, 0);
    EXPECT_THAT(breaches.take(), ElementsAre("CQuarnApp::RunScript: it names no open document"));
}

// ---- Script files

TEST_F(CommandRunnerTest, AScriptFileSkipsBlankLinesCommentsAndTheByteOrderMark) {
    EXPECT_EQ(runScript("\xEF\xBB\xBFGood\r\n\n  # a remark\n   \nGood"), std::nullopt);
    EXPECT_EQ(good_runs, 2);
    EXPECT_EQ(printed(), "");
}

TEST_F(CommandRunnerTest, AScriptFileStopsAtTheFirstCommandThatFailsAndTellsItsLine) {
    EXPECT_EQ(runScript("Good\n\nBad\nGood\n"), "steps.txt, line 3: Bad: failed.");
    EXPECT_EQ(good_runs, 1);
    EXPECT_EQ(printed(), "");
}

TEST_F(CommandRunnerTest, ABadAnswerInAScriptFileIsToldWithItsLineAndNeverAnswersTheNextQuestion) {
    std::wstring second = L"untouched";
    TestCommand two(L"Two", [&](const CQuarnCommandContext&) {
        CQuarnGetInteger first;
        first.SetCommandPrompt(L"Number of frames");
        first.SetLowerLimit(1.0, true);
        if (first.GetNumber() != CQuarnGet::number)
            return first.CommandResult();
        CQuarnGetString get;
        get.GetString();
        second = get.String();
        return CQuarnCommand::success;
    });
    add(two);
    EXPECT_EQ(runScript("Good\nTwo 0 Walk\n"), "steps.txt, line 2: Two 0 Walk: was cancelled.");
    EXPECT_EQ(second, L"untouched");
    EXPECT_EQ(printed(),
              "steps.txt, line 2: Two: \"0\" does not answer \"Number of frames\". Enter "
              "a number of at least 1.\n");
}

TEST_F(CommandRunnerTest, AMissingScriptFileIsTold) {
    EXPECT_EQ(session.runScriptFile("no/such/file.txt"), "There is no file no/such/file.txt.");
    EXPECT_EQ(printed(), "");
}

TEST_F(CommandRunnerTest, AFileThatIsNoTextIsNoScriptAndRunsNothing) {
    for (const char* line : {"Bad \x1B[2J", "glTF\x02", "a\x7F"}) {
        const std::optional<std::string> trouble = runScript(std::string("Good\n") + line + "\n");
        ASSERT_TRUE(trouble) << line;
        EXPECT_THAT(*trouble, HasSubstr("steps.txt is no script: line 2 holds control characters"));
    }
    EXPECT_EQ(good_runs, 0);
    EXPECT_EQ(runScript("\tGood\t\r\n"), std::nullopt);
}

TEST_F(CommandRunnerTest, AnInterruptedScriptFileStopsBeforeItsNextLine) {
    TestCommand stop(L"Stop", [&](const CQuarnCommandContext&) {
        front_end.interrupt();
        return CQuarnCommand::success;
    });
    add(stop);
    EXPECT_EQ(runScript("Stop\nGood\n"), "Stopped before steps.txt, line 2.");
    EXPECT_EQ(good_runs, 0);
}

TEST_F(CommandRunnerTest, ExitEndsAScriptFileWithSuccess) {
    EXPECT_FALSE(session.isExitRequested());
    EXPECT_EQ(runScript("Exit\nBad\n"), std::nullopt);
    EXPECT_TRUE(session.isExitRequested());
}

} // namespace
} // namespace quarn::test
