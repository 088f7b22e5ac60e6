#include "sdk/qncore/QnApp.h"
#include "sdk/qncore/QnGet.h"
#include "tests/host/app/TestCommand.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using testing::HasSubstr;
using testing::Not;

class TypedCommandTest : public HostTest {
protected:
    TypedCommandTest() { add(m_ask); }

    CQuarnCommand::result askTwice() {
        CQuarnGetInteger get;
        get.SetLowerLimit(1.0);
        for (int& number : m_numbers) {
            get.SetCommandPrompt(&number == m_numbers ? L"Columns" : L"Rows");
            if (get.GetNumber() != CQuarnGet::number)
                return get.CommandResult();
            number = get.Number();
        }
        return CQuarnCommand::success;
    }

    int m_numbers[2] = {0, 0};
    TestCommand m_ask{L"Grid", [this](const CQuarnCommandContext& context) {
                          m_was_interactive = context.IsInteractive();
                          return askTwice();
                      }};
    bool m_was_interactive = true;
};

TEST_F(TypedCommandTest, AsksForTheAnswersThatTheLineLacks) {
    front_end.addAnswer(L"5");
    EXPECT_EQ(session.runTypedCommand(L"Grid 4"), CQuarnCommand::success);
    EXPECT_EQ(m_numbers[0], 4);
    EXPECT_EQ(m_numbers[1], 5);
    EXPECT_EQ(front_end.questions().size(), 1u);
    EXPECT_FALSE(m_was_interactive);
}

TEST_F(TypedCommandTest, AsksAgainForAWordThatDoesNotFitAndDropsTheWordsBehindIt) {
    front_end.addAnswer(L"4");
    front_end.addAnswer(L"5");
    EXPECT_EQ(session.runTypedCommand(L"Grid 0 7"), CQuarnCommand::success);
    EXPECT_THAT(printed(), HasSubstr("\"0\" does not answer \"Columns\""));
    EXPECT_THAT(printed(), Not(HasSubstr("did not use")));
    EXPECT_EQ(m_numbers[0], 4);
    EXPECT_EQ(m_numbers[1], 5);
}

TEST_F(TypedCommandTest, EndsWhereNobodyCanBeAskedAgain) {
    EXPECT_EQ(session.runTypedCommand(L"Grid 0 7"), CQuarnCommand::cancel);
    EXPECT_EQ(m_numbers[0], 0);
}

TEST_F(TypedCommandTest, QuotesAroundAWholeAnswerAreNoPartOfIt) {
    std::vector<std::string> answers;
    TestCommand name(L"Name", [&answers](const CQuarnCommandContext&) {
        CQuarnGetString get;
        get.SetCommandPrompt(L"Name");
        get.GetString();
        answers.push_back(KM_wString(get.String()).ToUtf8());
        return get.CommandResult();
    });
    add(name);
    for (const wchar_t* typed : {L"\"North gate\"", L"\"_Enter\"", L"\"a\" or \"b\"", L"\""}) {
        front_end.addAnswer(typed);
        session.runTypedCommand(L"Name");
    }
    EXPECT_THAT(answers, testing::ElementsAre("North gate", "_Enter", "\"a\" or \"b\"", "\""));
}

TEST_F(TypedCommandTest, ScriptsOfACommandAreNotTyped) {
    CQuarnCommand::result nested = CQuarnCommand::success;
    bool succeeded = true;
    TestScriptCommand outer(L"Outer", [&](const CQuarnCommandContext& context) {
        succeeded = QuarnApp().RunScript(context.Document().RuntimeSerialNumber(), L"Grid 0 7", 0);
        return nested;
    });
    add(outer);
    front_end.addAnswer(L"4");
    session.runTypedCommand(L"Outer");
    EXPECT_FALSE(succeeded);
    EXPECT_TRUE(front_end.questions().empty());
}

TEST_F(TypedCommandTest, NamesOfCommandsAreInBothLanguagesAndInOrder) {
    TestCommand local(L"Zebra", [](const CQuarnCommandContext&) { return CQuarnCommand::success; });
    local.m_local_name = L"Streifen";
    add(local);
    const std::vector<CommandName> names = session.commandNames();
    ASSERT_GT(names.size(), 3u);
    EXPECT_TRUE(names.back().english == L"Zebra");
    EXPECT_TRUE(names.back().local == L"Streifen");
    for (std::size_t i = 1; i < names.size(); ++i)
        EXPECT_LT(names[i - 1].english.CompareNoCase(names[i].english), 0);
}

} // namespace
} // namespace quarn::test
