#include "sdk/qncore/QnGet.h"
#include "tests/host/app/TestCommand.h"
#include "tests/host/border/BreachList.h"

#include <gmock/gmock.h>

#include <limits>

namespace quarn::test {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::StartsWith;

CQuarnCommandOptionName name(const wchar_t* english, const wchar_t* local = L"") {
    return {english, *local ? local : english};
}

CQuarnCommandOptionValue value(const wchar_t* english, const wchar_t* local = L"") {
    return {english, *local ? local : english};
}

/// Asks one question inside a command `Ask` and keeps how it ended.
class PromptTest : public HostTest {
protected:
    /// Runs `Ask <words>`; the question is set up by `set_up` and asked by `ask`.
    template <class Get, class SetUp> void ask(const std::wstring& words, SetUp set_up) {
        TestCommand command(L"Ask", [&](const CQuarnCommandContext&) {
            Get get;
            get.SetCommandPrompt(L"Size");
            set_up(get);
            askIt(get);
            result = get.Result();
            command_result = get.CommandResult();
            picked = get.Option() ? get.Option()->m_option_index : 0;
            return get.CommandResult();
        });
        add(command);
        ended = session.runCommand(L"Ask " + words);
    }

    void askIt(CQuarnGetOption& get) {
        get.GetOption();
        text = get.String();
    }
    void askIt(CQuarnGetString& get) {
        get.GetString();
        text = get.String();
    }
    void askIt(CQuarnGetNumber& get) {
        get.GetNumber();
        number = get.Number();
    }
    void askIt(CQuarnGetInteger& get) {
        get.GetNumber();
        number = get.Number();
    }

    CQuarnGet::result result = CQuarnGet::no_result;
    CQuarnCommand::result command_result = CQuarnCommand::failure;
    CQuarnCommand::result ended = CQuarnCommand::failure;
    int picked = 0;
    std::wstring text;
    double number = 0;
};

void twoDirections(CQuarnGetOption& get) {
    EXPECT_EQ(get.AddCommandOption(name(L"Clockwise", L"Uhrzeigersinn")), 1);
    EXPECT_EQ(get.AddCommandOption(name(L"AntiClockwise", L"Gegensinn")), 2);
}

void oneToTwelve(CQuarnGetInteger& get) {
    get.SetLowerLimit(1.0, true);
    get.SetUpperLimit(12.0);
}

// ---- Options

TEST_F(PromptTest, AnOptionIsPickedByEitherNameInAnyCaseWithOrWithoutUnderscore) {
    for (const wchar_t* word : {L"AntiClockwise", L"_AntiClockwise", L"anticlockwise",
                                L"_ANTICLOCKWISE", L"Gegensinn", L"_gegensinn"}) {
        picked = 0;
        ask<CQuarnGetOption>(word, twoDirections);
        EXPECT_EQ(result, CQuarnGet::option);
        EXPECT_EQ(picked, 2) << KM_wString(word).ToUtf8();
        EXPECT_EQ(command_result, CQuarnCommand::success);
    }
}

TEST_F(PromptTest, AnOptionQuestionHandsOtherWordsOnAsText) {
    ask<CQuarnGetOption>(L"\"/tmp/my frames\"", twoDirections);
    EXPECT_EQ(result, CQuarnGet::string);
    EXPECT_EQ(text, L"/tmp/my frames");
    EXPECT_EQ(picked, 0);
}

TEST_F(PromptTest, AWordThatIsNoOptionIsToldWithTheOptionsNames) {
    ask<CQuarnGetOption>(L"Klockwise", twoDirections);
    EXPECT_EQ(result, CQuarnGet::string) << "it is handed on";
    EXPECT_EQ(text, L"Klockwise");
    EXPECT_EQ(printed(), "Ask: \"Klockwise\" is no option here. The options are "
                         "Uhrzeigersinn, Gegensinn.\n");
}

TEST_F(PromptTest, APersonIsToldThatAWordIsNoOption) {
    front_end.addAnswer(L"Klockwise");
    ask<CQuarnGetOption>(L"", twoDirections);
    EXPECT_EQ(text, L"Klockwise");
    EXPECT_THAT(printed(), StartsWith("\"Klockwise\" is no option here."));
}

TEST_F(PromptTest, AnOptionQuestionThatTakesTextTellsNothing) {
    ask<CQuarnGetOption>(L"/tmp/frames", [](CQuarnGetOption& get) {
        twoDirections(get);
        get.AcceptString();
    });
    EXPECT_EQ(text, L"/tmp/frames");
    EXPECT_EQ(printed(), "");
}

TEST_F(PromptTest, ADefaultThatIsNoOptionIsNotToldWhenEnterTakesIt) {
    ask<CQuarnGetOption>(L"_Enter", [](CQuarnGetOption& get) {
        twoDirections(get);
        get.SetDefaultString(L"gif");
    });
    EXPECT_EQ(text, L"gif");
    EXPECT_EQ(printed(), "");
}

TEST_F(PromptTest, AnOptionWithoutAToggleTakesNoValue) {
    ask<CQuarnGetOption>(L"Clockwise=1", twoDirections);
    EXPECT_EQ(result, CQuarnGet::string);
    EXPECT_EQ(text, L"Clockwise=1");
}

TEST_F(PromptTest, OptionsAreAddedOnceAndHaveAName) {
    ask<CQuarnGetOption>(L"x", [](CQuarnGetOption& get) {
        EXPECT_EQ(get.AddCommandOption(name(L"Wide")), 1);
        EXPECT_EQ(get.AddCommandOption(name(L"wide")), 0);
        EXPECT_EQ(get.AddCommandOption(name(L"")), 0);
        EXPECT_EQ(get.AddCommandOption(name(L"Narrow")), 2);
        get.ClearCommandOptions();
        EXPECT_EQ(get.AddCommandOption(name(L"Narrow")), 1);
    });
}

TEST_F(PromptTest, AnOptionIsPickedAtANumberQuestionToo) {
    ask<CQuarnGetNumber>(L"_auto",
                         [](CQuarnGetNumber& get) { get.AddCommandOption(name(L"Auto")); });
    EXPECT_EQ(result, CQuarnGet::option);
    EXPECT_EQ(picked, 1);
}

// ---- Toggles

struct ToggleCase {
    const wchar_t* word;
    bool before;
    bool after;
};

TEST_F(PromptTest, AToggleIsSetByValueOrChangedByItsName) {
    for (const ToggleCase& c : {ToggleCase{L"RunAnimation", false, true},
                                {L"_RunAnimation", true, false},
                                {L"RunAnimation=Yes", false, true},
                                {L"_runanimation=_yes", true, true},
                                {L"RunAnimation=Nein", true, false},
                                {L"Abspielen=Ja", false, true}}) {
        bool run = !c.before;
        ask<CQuarnGetOption>(c.word, [&](CQuarnGetOption& get) {
            get.AddCommandOptionToggle(name(L"RunAnimation", L"Abspielen"), value(L"No", L"Nein"),
                                       value(L"Yes", L"Ja"), c.before, &run);
            EXPECT_EQ(run, c.before);
        });
        EXPECT_EQ(result, CQuarnGet::option) << KM_wString(c.word).ToUtf8();
        EXPECT_EQ(run, c.after) << KM_wString(c.word).ToUtf8();
    }
}

TEST_F(PromptTest, AToggleRefusesAValueItHasNot) {
    bool run = false;
    ask<CQuarnGetOption>(L"RunAnimation=Maybe", [&](CQuarnGetOption& get) {
        get.AddCommandOptionToggle(name(L"RunAnimation"), value(L"No"), value(L"Yes"), false, &run);
    });
    EXPECT_EQ(result, CQuarnGet::cancel);
    EXPECT_FALSE(run);
    EXPECT_THAT(printed(), HasSubstr("Enter RunAnimation=No or RunAnimation=Yes."));
}

TEST_F(PromptTest, TheQuestionShowsTheValueThatAToggleHasNow) {
    front_end.addAnswer(L"RunAnimation");
    front_end.addAnswer(L"_Enter");
    TestCommand command(L"Ask", [&](const CQuarnCommandContext&) {
        CQuarnGetOption get;
        get.AcceptNothing();
        bool run = false;
        get.AddCommandOptionToggle(name(L"RunAnimation"), value(L"No"), value(L"Yes"), false, &run);
        get.AddCommandOption(name(L"TargetFolder"), value(L"out"));
        while (get.GetOption() == CQuarnGet::option) {
        }
        return CQuarnCommand::success;
    });
    add(command);
    run(L"Ask");
    ASSERT_EQ(front_end.questions().size(), 2U);
    EXPECT_STREQ(front_end.questions()[0].options[0].value, L"No");
    EXPECT_STREQ(front_end.questions()[0].options[1].value, L"out");
    EXPECT_STREQ(front_end.questions()[1].options[0].value, L"Yes");
}

// ---- Text

TEST_F(PromptTest, AWordAtATextQuestionIsTextAlsoWhenItNamesAnOption) {
    for (const wchar_t* word : {L"RenderFull", L"_RenderFull", L"a=b"}) {
        ask<CQuarnGetString>(
            word, [](CQuarnGetString& get) { get.AddCommandOption(name(L"RenderFull")); });
        EXPECT_EQ(result, CQuarnGet::string);
        EXPECT_EQ(text, word);
    }
}

TEST_F(PromptTest, AWordLikeAnEnglishOptionOfATextQuestionIsToldToBeNoneWhenTheCommandFailsAtIt) {
    CQuarnCommand::result ending = CQuarnCommand::success;
    TestCommand choose(L"Choose", [&](const CQuarnCommandContext&) {
        CQuarnGetString get;
        get.AddCommandOption(name(L"Shaded"));
        get.GetString();
        text = get.String();
        return ending;
    });
    add(choose);
    run(L"Choose _ShadedViewport");
    EXPECT_EQ(text, L"_ShadedViewport") << "it is handed on";
    EXPECT_EQ(printed(), "") << "the command understood it";
    ending = CQuarnCommand::failure;
    for (const wchar_t* line : {L"Choose _Shaded", L"Choose Garden", L"Choose \"_Garden\""})
        run(line);
    EXPECT_EQ(printed(), "");
    run(L"Choose _ShadedViewport");
    EXPECT_EQ(printed(),
              "Choose: \"_ShadedViewport\" is no option here. The options are Shaded.\n");
}

TEST_F(PromptTest, AMistakeThatACommandWentOnFromIsNotToldWhenItFailsLater) {
    TestCommand choose(L"Choose", [&](const CQuarnCommandContext&) {
        CQuarnGetString get;
        get.AddCommandOption(name(L"Shaded"));
        get.GetString();
        get.GetString();
        return CQuarnCommand::failure;
    });
    add(choose);
    run(L"Choose _ShadedViewport Garden");
    EXPECT_EQ(printed(), "");
}

TEST_F(PromptTest, AnOptionOfATextQuestionIsClickedInBrackets) {
    for (const wchar_t* word : {L"[RenderFull]", L"[_renderfull]"}) {
        picked = 0;
        ask<CQuarnGetString>(
            word, [](CQuarnGetString& get) { get.AddCommandOption(name(L"RenderFull")); });
        EXPECT_EQ(result, CQuarnGet::option);
        EXPECT_EQ(picked, 1);
    }
}

TEST_F(PromptTest, BracketsAroundNoOptionAndQuotedBracketsAreText) {
    for (const wchar_t* word : {L"[Other]", L"\"[RenderFull]\""}) {
        ask<CQuarnGetString>(
            word, [](CQuarnGetString& get) { get.AddCommandOption(name(L"RenderFull")); });
        EXPECT_EQ(result, CQuarnGet::string);
    }
    EXPECT_EQ(text, L"[RenderFull]");
}

// ---- Enter and Escape

TEST_F(PromptTest, EnterIsNothingWhereNothingIsAcceptedAndTheTextIsTheDefault) {
    ask<CQuarnGetString>(L"_enter", [](CQuarnGetString& get) {
        get.SetDefaultString(L"Walk");
        get.AcceptNothing(true);
    });
    EXPECT_EQ(result, CQuarnGet::nothing);
    EXPECT_EQ(command_result, CQuarnCommand::success);
    EXPECT_EQ(text, L"Walk");
}

TEST_F(PromptTest, EnterTakesTheDefaultWhereSomethingIsWanted) {
    ask<CQuarnGetString>(L"_Enter", [](CQuarnGetString& get) { get.SetDefaultString(L"Walk"); });
    EXPECT_EQ(result, CQuarnGet::string);
    EXPECT_EQ(text, L"Walk");
    ask<CQuarnGetInteger>(L"_Enter", [](CQuarnGetInteger& get) { get.SetDefaultInteger(100); });
    EXPECT_EQ(result, CQuarnGet::number);
    EXPECT_EQ(number, 100);
    ask<CQuarnGetNumber>(L"_Enter", [](CQuarnGetNumber& get) { get.SetDefaultNumber(0.1); });
    EXPECT_EQ(result, CQuarnGet::number);
    EXPECT_EQ(number, 0.1);
}

TEST_F(PromptTest, ANumberHoldsItsDefaultAfterNothing) {
    ask<CQuarnGetInteger>(L"_Enter", [](CQuarnGetInteger& get) {
        get.SetDefaultInteger(100);
        get.AcceptNothing();
    });
    EXPECT_EQ(result, CQuarnGet::nothing);
    EXPECT_EQ(number, 100);
}

TEST_F(PromptTest, EnterWithoutADefaultIsRefused) {
    ask<CQuarnGetString>(L"_Enter", [](CQuarnGetString&) {});
    EXPECT_EQ(result, CQuarnGet::cancel);
    EXPECT_EQ(printed(), "Ask: \"_Enter\" does not answer \"Size\". Enter an answer; there is no "
                         "default.\n");
}

TEST_F(PromptTest, CancelIsEscapeAtEveryQuestion) {
    ask<CQuarnGetString>(L"_Cancel", [](CQuarnGetString&) {});
    EXPECT_EQ(result, CQuarnGet::cancel);
    EXPECT_EQ(command_result, CQuarnCommand::cancel);
    ask<CQuarnGetOption>(L"_cancel", twoDirections);
    EXPECT_EQ(result, CQuarnGet::cancel);
    ask<CQuarnGetInteger>(L"_CANCEL", oneToTwelve);
    EXPECT_EQ(result, CQuarnGet::cancel);
    EXPECT_EQ(ended, CQuarnCommand::cancel);
    EXPECT_EQ(printed(), "");
}

TEST_F(PromptTest, AQuotedEnterIsTheTextItself) {
    ask<CQuarnGetString>(L"\"_Enter\"", [](CQuarnGetString&) {});
    EXPECT_EQ(result, CQuarnGet::string);
    EXPECT_EQ(text, L"_Enter");
}

// ---- Numbers and limits

TEST_F(PromptTest, LimitsIncludeThemselvesWhateverTheStrictFlagSays) {
    for (const wchar_t* word : {L"1", L"12"}) {
        ask<CQuarnGetInteger>(word, oneToTwelve);
        EXPECT_EQ(result, CQuarnGet::number);
    }
    for (const wchar_t* word : {L"0", L"13", L"-3"}) {
        ask<CQuarnGetInteger>(word, oneToTwelve);
        EXPECT_EQ(result, CQuarnGet::cancel);
    }
    EXPECT_THAT(printed(),
                HasSubstr("Ask: \"13\" does not answer \"Size\". Enter a number from 1 to "
                          "12.\n"));
}

TEST_F(PromptTest, AnIntegerQuestionRefusesFractionsOverflowAndWords) {
    ask<CQuarnGetInteger>(L"3.5", oneToTwelve);
    EXPECT_EQ(result, CQuarnGet::cancel);
    EXPECT_THAT(printed(),
                HasSubstr("\"3.5\" does not answer \"Size\". Enter a whole number from 1 "
                          "to 12."));
    ask<CQuarnGetInteger>(L"many", [](CQuarnGetInteger&) {});
    EXPECT_THAT(printed(), HasSubstr("Enter a whole number."));
    ask<CQuarnGetInteger>(L"99999999999", [](CQuarnGetInteger&) {});
    EXPECT_EQ(result, CQuarnGet::cancel);
    EXPECT_THAT(printed(), HasSubstr("Enter a whole number of at most 2147483647."));
}

TEST_F(PromptTest, ANumberQuestionRefusesWhatIsNoFiniteNumber) {
    for (const wchar_t* word : {L"nan", L"inf", L"3,5", L"1e999"}) {
        ask<CQuarnGetNumber>(word, [](CQuarnGetNumber& get) { get.SetLowerLimit(0.5); });
        EXPECT_EQ(result, CQuarnGet::cancel);
    }
    EXPECT_THAT(printed(), HasSubstr("Enter a number of at least 0.5."));
}

TEST_F(PromptTest, TheUnsetValueAsALimitIsNoLimit) {
    ask<CQuarnGetNumber>(L"-1e300", [](CQuarnGetNumber& get) {
        get.SetLowerLimit(KM_UNSET_VALUE);
        get.SetUpperLimit(KM_UNSET_VALUE);
    });
    EXPECT_EQ(number, -1e300);
}

TEST_F(PromptTest, ADefaultOutsideTheLimitsIsRefused) {
    ask<CQuarnGetInteger>(L"_Enter", [](CQuarnGetInteger& get) {
        get.SetDefaultInteger(0);
        oneToTwelve(get);
    });
    EXPECT_EQ(result, CQuarnGet::cancel);
    EXPECT_THAT(printed(), HasSubstr("Enter a number from 1 to 12."));
}

// ---- Who answers

TEST_F(PromptTest, ThePersonIsAskedWhenTheWordsRunOut) {
    front_end.addAnswer(L"7");
    ask<CQuarnGetInteger>(L"", oneToTwelve);
    EXPECT_EQ(number, 7);
    ASSERT_EQ(front_end.questions().size(), 1U);
    EXPECT_STREQ(front_end.questions()[0].prompt, L"Size");
    EXPECT_EQ(front_end.questions()[0].kind, Question::Kind::integer);
}

TEST_F(PromptTest, APersonIsToldABadAnswerAndAskedAgain) {
    for (const wchar_t* answer : {L"13", L"", L"5"})
        front_end.addAnswer(answer);
    ask<CQuarnGetInteger>(L"", oneToTwelve);
    EXPECT_EQ(result, CQuarnGet::number);
    EXPECT_EQ(number, 5);
    EXPECT_EQ(front_end.questions().size(), 3U);
    EXPECT_EQ(printed(), "Enter a number from 1 to 12.\nEnter an answer; there is no default.\n");
}

TEST_F(PromptTest, AMissingAnswerIsNamedAndCancels) {
    ask<CQuarnGetOption>(L"", twoDirections);
    EXPECT_EQ(result, CQuarnGet::cancel);
    EXPECT_EQ(ended, CQuarnCommand::cancel);
    EXPECT_EQ(printed(), "Ask needs an answer to \"Size\" (Uhrzeigersinn, Gegensinn); none was "
                         "given.\n");
}

TEST_F(PromptTest, AQuestionOutsideACommandFailsAndIsTold) {
    CQuarnGetString get;
    BreachList breaches;
    EXPECT_EQ(get.GetString(), CQuarnGet::no_result);
    EXPECT_EQ(get.CommandResult(), CQuarnCommand::failure);
    EXPECT_THAT(breaches.take(), ElementsAre("CQuarnGetString::GetString: questions may be asked "
                                             "while a command runs"));
}

} // namespace
} // namespace quarn::test
