#include "desktop/command_line/CommandPane.h"

#include "tests/desktop/WindowParts.h"

#include <QScrollBar>
#include <QSettings>

#include <gmock/gmock.h>

namespace quarn::desktop::test {
namespace {

class CommandPaneTest : public WindowPartsTest {
protected:
    CommandPaneTest() {
        pane.resize(800, 300);
        pane.show();
        pane.activateWindow();
        EXPECT_TRUE(QTest::qWaitForWindowActive(&pane));
        usePart([this](FrontEndParts& used) {
            used.print = [this](std::wstring_view text) { pane.print(text); };
            used.ask = [this](const Question& question) {
                questions.append(qtText(question.prompt));
                return pane.ask(question);
            };
        });
        QObject::connect(&pane, &CommandPane::lineEntered,
                         [this](const QString& line) { entered.append(line); });
        pane.line().setFocus();
    }

    void type(const QString& text) { QTest::keyClicks(&pane.line(), text); }
    void press(Qt::Key key) { QTest::keyClick(&pane.line(), key); }
    QPushButton& button(const QString& name) { return part<QPushButton>(pane, name); }
    QString said() const { return const_cast<CommandPane&>(pane).output().toPlainText(); }
    /// Starts a command and does these things, one at each question.
    void answering(const QString& line, std::vector<std::function<void()>> answers) {
        std::size_t next = 0;
        QTimer clock;
        QObject::connect(&clock, &QTimer::timeout, [&] {
            if (pane.isAsking() && next < answers.size() &&
                questions.size() == static_cast<qsizetype>(next) + 1)
                answers[next++]();
            else if (pane.isAsking() && next == answers.size())
                pane.cancelQuestion();
        });
        questions.clear();
        clock.start(1);
        starter.start(line);
        EXPECT_EQ(next, answers.size()) << said().toStdString();
    }

    CommandPane pane{session};
    QStringList questions;
    QStringList entered;
};

TEST_F(CommandPaneTest, ALineIsHandedOnWithoutBlanksAroundIt) {
    type("  _List ");
    press(Qt::Key_Return);
    EXPECT_EQ(entered, QStringList{"_List"});
    EXPECT_EQ(pane.line().text(), "");
}

TEST_F(CommandPaneTest, ABlankLineIsNone) {
    type("  ");
    press(Qt::Key_Return);
    EXPECT_TRUE(entered.isEmpty());
}

TEST_F(CommandPaneTest, UpAndDownCallBackLinesAndKeepWhatWasBeingTyped) {
    for (const char* line : {"First 1", "Second 2"}) {
        type(line);
        press(Qt::Key_Return);
    }
    type("Zzz");
    press(Qt::Key_Up);
    EXPECT_EQ(pane.line().text(), "Second 2");
    press(Qt::Key_Up);
    press(Qt::Key_Up);
    EXPECT_EQ(pane.line().text(), "First 1");
    press(Qt::Key_Down);
    press(Qt::Key_Down);
    EXPECT_EQ(pane.line().text(), "Zzz");
}

TEST_F(CommandPaneTest, LinesAreKeptForTheNextRunButNotTwiceInARow) {
    for (const char* line : {"List", "List", "Help"}) {
        type(line);
        press(Qt::Key_Return);
    }
    EXPECT_EQ(LineHistory().lines(), (QStringList{"List", "Help"}));
}

TEST_F(CommandPaneTest, OnlyTheNewestLinesAreKept) {
    QStringList lines;
    for (int i = 0; i < LineHistory::LINES_KEPT; ++i)
        lines.append(QString::number(i));
    QSettings().setValue("command_line/history", lines);
    LineHistory history;
    for (const char* line : {"a", "b", "c"})
        history.add(line);
    EXPECT_EQ(LineHistory().lines().size(), LineHistory::LINES_KEPT);
    EXPECT_EQ(LineHistory().lines().first(), "3");
}

TEST_F(CommandPaneTest, TabCompletesTheOnlyName) {
    type("_SetTurn");
    press(Qt::Key_Tab);
    EXPECT_EQ(pane.line().text(), "_SetTurntableAnimation ");
}

TEST_F(CommandPaneTest, TabCompletesWhatAllNamesShareThenTheChosenOne) {
    type("_savef");
    EXPECT_FALSE(pane.line().completionList().isHidden());
    press(Qt::Key_Tab);
    EXPECT_EQ(pane.line().text(), "_SaveFrame ");
    pane.line().clear();
    type("_setp");
    pane.line().clear();
    type("_renderp");
    press(Qt::Key_Tab);
    EXPECT_EQ(pane.line().text(), "_RenderPreview ");
    pane.line().clear();
    type("_sp"); // Spline, SplineThrough
    press(Qt::Key_Tab);
    EXPECT_EQ(pane.line().text(), "_Spline");
    press(Qt::Key_Down);
    press(Qt::Key_Down);
    press(Qt::Key_Return);
    EXPECT_EQ(pane.line().text(), "_SplineThrough ");
    EXPECT_TRUE(entered.isEmpty());
}

TEST_F(CommandPaneTest, AClickCompletesAndEscapeClosesTheList) {
    type("_sp");
    QListWidget& list = pane.line().completionList();
    ASSERT_EQ(list.count(), 2);
    QTest::mouseClick(list.viewport(), Qt::LeftButton, {},
                      list.visualItemRect(list.item(1)).center());
    EXPECT_EQ(pane.line().text(), "_SplineThrough ");
    pane.line().clear();
    type("_sp");
    press(Qt::Key_Escape);
    EXPECT_TRUE(list.isHidden());
    EXPECT_EQ(pane.line().text(), "_sp");
}

TEST_F(CommandPaneTest, NamesOfFilesWithBlanksAreCompletedInQuotes) {
    quarn::test::writeFile(folder / "a house.obj", "");
    type("Open " + qtText(folder / "a h"));
    press(Qt::Key_Tab);
    // A second candidate could begin at the blank; in quotes the name is one word.
    pane.line().clear();
    type("Open " + qtText(folder / "a"));
    press(Qt::Key_Tab);
    EXPECT_EQ(pane.line().text(), "Open \"" + qtText(folder / "a house.obj") + "\" ");
}

TEST_F(CommandPaneTest, AWholeCommandIsAnsweredByClickingAndTyping) {
    run("_Polyline 0,0,0 4,0,0 4,4,0 _Enter");
    answering("_-SetTurntableAnimation",
              {[&] {
                   EXPECT_EQ(pane.askedKind(), Question::Kind::integer);
                   EXPECT_TRUE(part<QLabel>(pane, "prompt").text().contains("Number of frames"));
                   type("7");
                   press(Qt::Key_Return);
               },
               [&] {
                   EXPECT_EQ(pane.askedKind(), Question::Kind::option);
                   click(button("option_AntiClockwise"));
               },
               [&] { click(button("option_png")); }, [&] { click(button("option_Wireframe")); },
               [&] { click(button("promptOk")); },
               [&] {
                   EXPECT_EQ(pane.askedKind(), Question::Kind::string);
                   type("Walk around");
                   click(button("promptOk"));
               }});
    EXPECT_EQ(last_result, CQuarnCommand::success) << said().toStdString();
    EXPECT_EQ(record().FrameCount(), 7);
    EXPECT_EQ(qtText(record().ViewportName()), "Perspective");
    EXPECT_EQ(qtText(record().FileExtension()), "png");
    EXPECT_TRUE(said().contains("Walk around"));
    EXPECT_FALSE(pane.isAsking());
    EXPECT_EQ(pane.askedKind(), std::nullopt);
}

TEST_F(CommandPaneTest, AWrongAnswerIsToldAndTheQuestionAskedAgain) {
    answering("_-SetTurntableAnimation", {[&] {
                                              type("many");
                                              press(Qt::Key_Return);
                                          },
                                          [&] { press(Qt::Key_Escape); }});
    EXPECT_EQ(questions.size(), 2);
    EXPECT_EQ(questions[0], questions[1]);
    EXPECT_TRUE(said().contains("Enter a whole number")) << said().toStdString();
    EXPECT_EQ(last_result, CQuarnCommand::cancel);
}

TEST_F(CommandPaneTest, EnterTakesTheDefault) {
    answering("_-SetTurntableAnimation", {[&] {
                                              EXPECT_TRUE(button("promptOk").isEnabled());
                                              press(Qt::Key_Return);
                                          },
                                          [&] { click(button("promptCancel")); }});
    EXPECT_EQ(questions.size(), 2);
}

TEST_F(CommandPaneTest, TipsShowWhatADocumentHoldsAsTextAndNotAsAPage) {
    setUpTurntable(2);
    KM_3dmAnimationProperties changed = record();
    changed.SetFolderName(L"<img src=a>");
    changed.SetHtmlFilename(L"<img src=b>");
    session.document().Properties().SetAnimationProperties(changed);
    QString of_option;
    QString of_default;
    answering("_RecordAnimation", {[&] {
                  of_option = button("option_TargetFolder").toolTip();
                  pane.cancelQuestion();
              }});
    answering("_AnimationName", {[&] {
                  of_default = button("promptOk").toolTip();
                  pane.cancelQuestion();
              }});
    EXPECT_TRUE(of_option.contains("TargetFolder = &lt;img src=a&gt;")) << of_option.toStdString();
    EXPECT_TRUE(of_default.contains("&lt;img src=b&gt;")) << of_default.toStdString();
}

TEST_F(CommandPaneTest, AToggleChangesWhenItIsClicked) {
    setUpTurntable(2);
    const auto caption = [&] { return button("option_RunAnimation").text(); };
    QString before;
    QString after;
    answering("_RecordAnimation", {[&] {
                                       before = caption();
                                       click(button("option_RunAnimation"));
                                   },
                                   [&] {
                                       after = caption();
                                       click(button("option_RunAnimation"));
                                   },
                                   [&] { pane.cancelQuestion(); }});
    EXPECT_EQ(before, "RunAnimation = No");
    EXPECT_EQ(after, "RunAnimation = Yes");
}

TEST_F(CommandPaneTest, AnObjectIsChosenFromTheListOrPointedAt) {
    run("_Polyline 0,0,0 4,0,0 4,4,0 _Enter");
    run("_Polyline 1,0,0 4,0,0 4,4,0 _Enter");
    QString chosen;
    answering("_Rename", {[&] {
                              EXPECT_EQ(pane.askedKind(), Question::Kind::object);
                              auto& objects = part<QComboBox>(pane, "promptObjects");
                              ASSERT_EQ(objects.count(), 3);
                              chosen = objects.itemText(1);
                              objects.setCurrentIndex(1);
                              emit objects.activated(1);
                          },
                          [&] {
                              type("Kerb");
                              press(Qt::Key_Return);
                          }});
    EXPECT_EQ(last_result, CQuarnCommand::success) << said().toStdString();
    EXPECT_FALSE(chosen.isEmpty());
    answering("_Rename", {[&] { pane.answerWithObject(KM_wString(L"Kerb")); },
                          [&] { pane.answer(KM_wString(L"Path")); }});
    EXPECT_EQ(last_result, CQuarnCommand::success) << said().toStdString();
}

TEST_F(CommandPaneTest, AnswersAreCompletedFromTheOptions) {
    answering("_-SetTurntableAnimation 5", {[&] {
                  type("anti");
                  press(Qt::Key_Tab);
                  EXPECT_EQ(pane.line().text(), "AntiClockwise");
                  pane.cancelQuestion();
              }});
}

TEST_F(CommandPaneTest, AQuestionWithinAQuestionIsAnsweredFirst) {
    Question outer;
    outer.prompt = L"Outer";
    Question inner;
    inner.prompt = L"Inner";
    Answer inner_answer;
    later([&] {
        later([&] { pane.answer(KM_wString(L"2")); });
        inner_answer = pane.ask(inner);
        EXPECT_TRUE(part<QLabel>(pane, "prompt").text().contains("Outer"));
        pane.answer(KM_wString(L"1"));
    });
    const Answer outer_answer = pane.ask(outer);
    EXPECT_EQ(qtText(inner_answer.text), "2");
    EXPECT_EQ(qtText(outer_answer.text), "1");
}

TEST_F(CommandPaneTest, WhatWasBeingTypedIsThereAgainAfterAQuestion) {
    type("_Sun o");
    Question question;
    question.prompt = L"Size";
    later([&] {
        EXPECT_EQ(pane.line().text(), "");
        EXPECT_TRUE(part<QWidget>(pane, "prompt").isVisible());
        press(Qt::Key_Escape);
    });
    EXPECT_EQ(pane.ask(question).kind, Answer::Kind::cancel);
    EXPECT_EQ(pane.line().text(), "_Sun o");
    EXPECT_FALSE(part<QWidget>(pane, "prompt").isVisible());
}

TEST_F(CommandPaneTest, OkNeedsAnAnswerWhereEnterIsNone) {
    Question question;
    question.prompt = L"File";
    question.kind = Question::Kind::string;
    later([&] {
        EXPECT_FALSE(button("promptOk").isEnabled());
        type("x");
        EXPECT_TRUE(button("promptOk").isEnabled());
        click(button("promptOk"));
    });
    EXPECT_EQ(qtText(pane.ask(question).text), "x");
}

TEST_F(CommandPaneTest, OutputShowsItsNewestLineAlsoWhereItLosesRoom) {
    pane.resize(600, 300);
    for (int i = 0; i < 100; ++i)
        pane.print(L"line\n");
    QScrollBar& bar = *pane.output().verticalScrollBar();
    ASSERT_EQ(bar.value(), bar.maximum());
    const int before = bar.maximum();
    pane.resize(600, 200);
    QApplication::processEvents();
    EXPECT_GT(bar.maximum(), before);
    EXPECT_EQ(bar.value(), bar.maximum());
}

TEST_F(CommandPaneTest, OutputKeepsItsPlaceForWhoScrolledUp) {
    for (int i = 0; i < 200; ++i)
        pane.print(L"a line\n");
    QScrollBar& bar = *pane.output().verticalScrollBar();
    EXPECT_EQ(bar.value(), bar.maximum());
    bar.setValue(10);
    pane.print(L"another\n");
    EXPECT_EQ(bar.value(), 10);
    bar.setValue(bar.maximum());
    pane.print(L"the last\n");
    EXPECT_EQ(bar.value(), bar.maximum());
}

TEST_F(CommandPaneTest, OutputKeepsTheNewestLines) {
    for (int i = 0; i < OutputPane::LINES_KEPT + 100; ++i)
        pane.print(L"a line\n");
    EXPECT_EQ(pane.output().document()->blockCount(), OutputPane::LINES_KEPT);
}

} // namespace
} // namespace quarn::desktop::test
