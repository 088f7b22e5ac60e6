#include "tests/quarn/Terminal.h"

#include <algorithm>
#include <chrono>
#include <csignal>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <random>
#include <thread>

namespace quarn::test {
namespace {

namespace fs = std::filesystem;
using namespace std::chrono_literals;
using testing::AnyOf;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using Clock = std::chrono::steady_clock;

constexpr const char* IDLE = "Command: ";
constexpr const char* OFFER = "This document was not saved when its program ended:";

class ConsoleRecovery : public testing::Test {
protected:
    Start start(const std::vector<std::string>& arguments = {}) const {
        Start start;
        start.folder = m_folder.path();
        start.environment = {{"XDG_STATE_HOME", (m_folder / "state").native()}, {"LC_ALL", "C"}};
        start.arguments = {"console"};
        start.arguments.insert(start.arguments.end(), arguments.begin(), arguments.end());
        return start;
    }
    std::string feed(const std::string& input) const {
        Start piped = start();
        piped.input = input;
        const Ended ended = run(piped);
        EXPECT_EQ(ended.exit_code, 0) << ended.err;
        return ended.out;
    }
    /// Files of recovery and marks of them, those that are being made too.
    int keptFiles() const {
        int count = 0;
        std::error_code changing;
        for (const auto& entry : fs::recursive_directory_iterator(m_folder.path(), changing)) {
            const std::string name = entry.path().filename().native();
            count += name.ends_with(".recovery") || name.ends_with(".mark");
        }
        return count;
    }
    bool isKept() const {
        const auto end = Clock::now() + 20s;
        while (keptFiles() < 2 && Clock::now() < end)
            std::this_thread::sleep_for(1ms);
        return keptFiles() == 2;
    }
    /// The points of the document that can be recovered.
    int recoveredPoints() const {
        const std::string out = feed("Recover\n\nList\n");
        EXPECT_THAT(out, HasSubstr("Recovered "));
        const std::size_t found = out.find(" points");
        const std::size_t begin = found == out.npos ? found : out.rfind(' ', found - 1);
        return begin == out.npos ? -1 : std::stoi(out.substr(begin));
    }

    TempFolder m_folder;
};

TEST_F(ConsoleRecovery, WorkOfAKilledProgramIsOfferedAtTheNextStartAndComesBack) {
    {
        Terminal terminal(start({"--recovery-every", "0.1"}));
        ASSERT_TRUE(terminal.shows(IDLE));
        terminal.type("Point 1,2,3\r");
        ASSERT_TRUE(isKept()) << "also while nothing is typed";
        terminal.sendSignal(SIGKILL);
        EXPECT_EQ(terminal.end().killed_by, SIGKILL);
    }
    Terminal terminal(start());
    ASSERT_TRUE(terminal.shows(OFFER)) << terminal.screen();
    ASSERT_TRUE(terminal.shows("a document without a name, kept 20"));
    ASSERT_TRUE(terminal.shows("Recover opens or discards it."));
    ASSERT_TRUE(terminal.shows(IDLE));
    terminal.type("Recover\r");
    ASSERT_TRUE(terminal.shows("Number of the document to recover <1> ( Discard ): "))
        << terminal.screen();
    terminal.type("\r");
    ASSERT_TRUE(terminal.shows("Recovered a document without a name")) << terminal.screen();
    ASSERT_TRUE(terminal.shows(IDLE));
    terminal.type("List\r");
    EXPECT_TRUE(terminal.shows("1 point")) << terminal.screen();
    terminal.type("SaveAs kept\r");
    ASSERT_TRUE(terminal.shows("Saved kept.quarn."));
    ASSERT_TRUE(terminal.shows(IDLE));
    terminal.type("Exit\r");
    EXPECT_EQ(terminal.end().exit_code, 0);
    EXPECT_EQ(keptFiles(), 0);
}

TEST_F(ConsoleRecovery, KilledAtAnyMomentItLosesNoMoreThanTheLastBeatAndNeverTheFile) {
    constexpr auto slowness = 700ms; // of a busy machine, besides the beat of 100 ms
    std::mt19937 random(20261122);
    for (int round = 0; round < 4; ++round) {
        feed("New\nPoint 0,0,0\nPoint 1,0,0\nSaveAs house\n");
        const std::string saved = readFile(m_folder / "house.quarn");
        const auto life =
            std::chrono::milliseconds(std::uniform_int_distribution(50, 1300)(random));
        std::vector<Clock::time_point> done;
        {
            Terminal terminal(start({"house.quarn", "--recovery-every", "0.1"}));
            ASSERT_TRUE(terminal.shows(IDLE));
            const auto end = Clock::now() + life;
            while (Clock::now() < end) {
                terminal.type("Point 5,5," + std::to_string(done.size()) + "\r");
                ASSERT_TRUE(terminal.shows("point at"));
                ASSERT_TRUE(terminal.shows(IDLE));
                done.push_back(Clock::now());
                std::this_thread::sleep_for(5ms);
            }
            terminal.sendSignal(SIGKILL);
            EXPECT_EQ(terminal.end().killed_by, SIGKILL);
        }
        const auto long_ago = Clock::now() - 100ms - slowness;
        const auto safe = std::ranges::count_if(done, [&](auto at) { return at < long_ago; });
        EXPECT_EQ(readFile(m_folder / "house.quarn"), saved);
        if (safe > 0 || keptFiles() > 0) {
            EXPECT_GE(recoveredPoints(), 2 + safe)
                << "of " << done.size() << " in " << life.count();
        }
        feed("Recover Discard 1\n");
        EXPECT_EQ(keptFiles(), 0);
    }
}

TEST_F(ConsoleRecovery, TwoProgramsWithOneDocumentKeepTheirWorkApart) {
    feed("Point 0,0,0\nPoint 1,0,0\nSaveAs house\n");
    Terminal first(start({"house.quarn", "--recovery-every", "0.1"}));
    ASSERT_TRUE(first.shows(IDLE));
    first.type("Point 1,2,3\r");
    ASSERT_TRUE(isKept());
    {
        Terminal second(start({"house.quarn", "--recovery-every", "0.1"}));
        ASSERT_TRUE(second.shows(IDLE));
        second.type("Point 4,5,6\r");
        ASSERT_TRUE(second.shows(IDLE));
        second.type("Exit\r");
        EXPECT_EQ(second.end().exit_code, 0);
        EXPECT_THAT(second.screen(), Not(HasSubstr(OFFER))) << "the first one still runs";
    }
    EXPECT_EQ(keptFiles(), 2);
    first.sendSignal(SIGKILL);
    first.end();
    EXPECT_EQ(recoveredPoints(), 3);
}

/// How a program is told to end, and whether it hears of that by its input alone.
struct Telling {
    int signal; ///< 0: its terminal goes
    bool ignores_hang_up = false;
};

class ConsoleToldToEnd : public ConsoleRecovery, public testing::WithParamInterface<Telling> {};

TEST_P(ConsoleToldToEnd, KeepsTheWorkThatNoBeatHasKeptYet) {
    {
        const auto before = std::signal(SIGHUP, GetParam().ignores_hang_up ? SIG_IGN : SIG_DFL);
        Terminal terminal(start({"--recovery-every", "3600"}));
        std::signal(SIGHUP, before);
        ASSERT_TRUE(terminal.shows(IDLE));
        terminal.type("Point 1,2,3\r");
        ASSERT_TRUE(terminal.shows("point at"));
        ASSERT_TRUE(terminal.shows(IDLE));
        EXPECT_EQ(keptFiles(), 0);
        if (GetParam().signal == 0)
            terminal.hangUp();
        else
            terminal.sendSignal(GetParam().signal);
        EXPECT_EQ(terminal.end().exit_code, 128 + std::max(GetParam().signal, SIGHUP));
        if (GetParam().signal != 0) {
            EXPECT_THAT(terminal.screen(), HasSubstr("the next quarn console offers it"));
        }
    }
    EXPECT_EQ(keptFiles(), 2);
    Terminal terminal(start());
    EXPECT_TRUE(terminal.shows(OFFER)) << terminal.screen();
}

INSTANTIATE_TEST_SUITE_P(Ways, ConsoleToldToEnd,
                         testing::Values(Telling{SIGTERM}, Telling{SIGHUP}, Telling{0},
                                         Telling{0, true}));

TEST_F(ConsoleRecovery, ToldToEndAtAQuestionItKeepsWhatStoodBefore) {
    {
        Terminal terminal(start({"--recovery-every", "3600"}));
        ASSERT_TRUE(terminal.shows(IDLE));
        terminal.type("Point 1,2,3\rPoint 4,5,6\rPolyline 0,0,0\r");
        ASSERT_TRUE(terminal.shows("Polyline"));
        ASSERT_TRUE(terminal.shows("): ")) << terminal.screen();
        terminal.sendSignal(SIGTERM);
        EXPECT_EQ(terminal.end().exit_code, 143);
    }
    EXPECT_EQ(recoveredPoints(), 2);
}

TEST_F(ConsoleRecovery, AnEndByAPersonsWishLeavesNothing) {
    for (const std::string& end : {std::string("Exit\r"), std::string(CTRL_D)}) {
        Terminal terminal(start({"--recovery-every", "0.1"}));
        ASSERT_TRUE(terminal.shows(IDLE));
        terminal.type("Point 1,2,3\r");
        ASSERT_TRUE(isKept());
        ASSERT_TRUE(terminal.shows("point at"));
        ASSERT_TRUE(terminal.shows(IDLE));
        terminal.type(end);
        EXPECT_EQ(terminal.end().exit_code, 0);
        EXPECT_EQ(keptFiles(), 0);
    }
}

TEST_F(ConsoleRecovery, WhereItIsNotWantedNothingIsKeptAndNothingOffered) {
    for (const bool is_wanted : {true, false}) {
        std::vector<std::string> arguments = {"--recovery-every", "0.1"};
        if (!is_wanted)
            arguments.emplace_back("--no-recovery");
        Terminal terminal(start(arguments));
        ASSERT_TRUE(terminal.shows(IDLE));
        EXPECT_THAT(terminal.screen(), Not(HasSubstr(OFFER)));
        terminal.type("Point 1,2,3\r");
        ASSERT_TRUE(terminal.shows("point at"));
        ASSERT_TRUE(terminal.shows(IDLE));
        if (is_wanted) {
            ASSERT_TRUE(isKept());
        }
        terminal.sendSignal(SIGTERM);
        EXPECT_EQ(terminal.end().exit_code, 143);
        EXPECT_EQ(keptFiles(), 2) << "of the first program alone";
    }
}

TEST_F(ConsoleRecovery, WhatIsPipedInIsNotOfferedAnything) {
    {
        Terminal terminal(start());
        ASSERT_TRUE(terminal.shows(IDLE));
        terminal.type("Point 1,2,3\r");
        ASSERT_TRUE(terminal.shows("point at"));
        terminal.sendSignal(SIGTERM);
        EXPECT_EQ(terminal.end().exit_code, 143);
    }
    EXPECT_THAT(feed("List\n"), Not(HasSubstr(OFFER)));
    EXPECT_EQ(keptFiles(), 2);
}

TEST_F(ConsoleRecovery, ATroubleIsToldOnceAndWorkGoesOn) {
    Start no_state = start({"--recovery-every", "0.1"});
    writeFile(m_folder / "file", "");
    no_state.environment["XDG_STATE_HOME"] = (m_folder / "file").native();
    Terminal terminal(no_state);
    ASSERT_TRUE(terminal.shows(IDLE));
    for (int i = 0; i < 5; ++i) {
        terminal.type("Point 1,2,3\r");
        ASSERT_TRUE(terminal.shows("point at"));
        ASSERT_TRUE(terminal.shows(IDLE));
        std::this_thread::sleep_for(150ms);
    }
    const std::string trouble = "Unsaved work cannot be kept for recovery: ";
    const std::size_t told = terminal.screen().find(trouble);
    EXPECT_NE(told, std::string::npos) << terminal.screen();
    EXPECT_EQ(terminal.screen().find(trouble, told + 1), std::string::npos) << terminal.screen();
}

} // namespace
} // namespace quarn::test
