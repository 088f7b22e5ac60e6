// Pages, films and cameras, made of a recording in the window.
#include "desktop/animation/AnimationBar.h"
#include "desktop/animation/SharedFileRow.h"
#include "tests/desktop/window/WindowFixture.h"

#include <QLabel>
#include <QPushButton>
#include <QToolButton>

namespace quarn::desktop::test {
namespace {

constexpr int FRAMES = 4;

class SharingTest : public WindowTest {
protected:
    SharingTest() {
        readSlab();
        run("_-ViewportSize 64 48");
        run("_AnimationName Turn");
        setUpTurntable(FRAMES);
        std::filesystem::create_directory(frames);
        run("_-RecordAnimation TargetFolder \"" + qtText(frames) + "\" _Enter");
        settle();
    }

    void makePage() { run("_-ViewerPage \"" + qtText(frames) + "\" _OneFile=Yes _Enter"); }
    QWidget& row() { return part<QWidget>(window, "sharedFileRow"); }
    QPushButton& button(const char* name) { return part<QPushButton>(window, name); }
    QString told() { return part<QLabel>(window, "sharedFileText").text(); }
    /// Looks at the window whenever it works on its events.
    void whileItWorks(const std::function<void()>& look) {
        QObject::connect(&m_clock, &QTimer::timeout, &window, look);
        m_clock.start(0);
    }
    void endHalfMadePage(const std::function<void()>& end) {
        bool is_ended = false;
        whileItWorks([&] {
            if (is_ended || !part<QLabel>(window, "progressText").text().contains("50 %"))
                return;
            is_ended = true;
            end();
        });
        makePage();
        EXPECT_TRUE(is_ended);
        EXPECT_FALSE(std::filesystem::exists(page));
        EXPECT_FALSE(row().isVisible());
        EXPECT_FALSE(window.starter().isRunning());
    }
    /// Puts an opener of files before those of the machine.
    void useOpener() {
        const std::filesystem::path opener = folder / "bin" / "xdg-open";
        std::filesystem::create_directory(folder / "bin");
        quarn::test::writeFile(opener,
                               "#!/bin/sh\nprintf '%s\\n' \"$1\" >>\"$0.opened\"\nexit 0\n");
        std::filesystem::permissions(opener, std::filesystem::perms::owner_all);
        qputenv("PATH", qtText(folder / "bin").toUtf8() + ':' + m_path);
    }
    std::string opened() { return quarn::test::readFile(folder / "bin" / "xdg-open.opened"); }
    ~SharingTest() override { qputenv("PATH", m_path); }

    const std::filesystem::path frames = folder / "frames";
    const std::filesystem::path page = frames / "Turn-viewer.html";

private:
    const QByteArray m_path = qgetenv("PATH");
    QTimer m_clock;
};

TEST_F(SharingTest, APageShowsHowFarItIsAndThenWhatThereIs) {
    QStringList seen;
    whileItWorks([&] {
        auto& text = part<QLabel>(window, "progressText");
        if (text.isVisible() && !seen.contains(text.text()))
            seen << text.text();
    });
    makePage();
    EXPECT_TRUE(seen.contains("Making Turn-viewer.html: 25 %")) << seen.join('|').toStdString();
    EXPECT_TRUE(seen.contains("Making Turn-viewer.html: 75 %"));
    EXPECT_FALSE(part<QLabel>(window, "progressText").isVisible());
    EXPECT_TRUE(row().isVisible()) << printed().toStdString();
    EXPECT_TRUE(told().startsWith("Turn-viewer.html: 4 pictures, ")) << told().toStdString();
    EXPECT_TRUE(printed().contains(qtText(page) + ": 4 pictures, "));
}

TEST_F(SharingTest, CancelEndsAPageAndNothingIsWritten) {
    endHalfMadePage([this] { click(button("progressCancel")); });
}

TEST_F(SharingTest, EscapeEndsAPageAndNothingIsWritten) {
    endHalfMadePage([this] { QTest::keyClick(&window.commandPane().line(), Qt::Key_Escape); });
}

TEST_F(SharingTest, APageAndItsFolderAreOpenedWithTheDesktopsPrograms) {
    useOpener();
    makePage();
    click(button("showInFolder"));
    EXPECT_EQ(opened(), frames.string() + '\n');
    click(button("sharedFileOpen"));
    EXPECT_EQ(opened(), frames.string() + '\n' + page.string() + '\n');
    EXPECT_TRUE(row().isVisible()) << "it may be wanted again";
    click(part<QToolButton>(window, "sharedFileClose"));
    EXPECT_FALSE(row().isVisible());
}

TEST_F(SharingTest, ACameraHasAFolderToShowAndNoPageToOpen) {
    run("_-ExportCamera \"" + qtText(folder / "camera.csv") + '"');
    EXPECT_TRUE(told().contains("camera.csv")) << told().toStdString();
    EXPECT_TRUE(button("showInFolder").isVisible());
    EXPECT_FALSE(button("sharedFileOpen").isVisible());
}

TEST_F(SharingTest, TheNextRecordingTakesTheResultOfTheLastAway) {
    makePage();
    ASSERT_TRUE(row().isVisible());
    run("_-RecordAnimation _Enter");
    EXPECT_FALSE(row().isVisible());
}

TEST_F(SharingTest, WhatIsNotMadeSaysWhyAndHasNothingToShow) {
    window.animationBar().sharedFileEnded(
        {folder / "a.mp4", false, KM_wString(L"a.mp4 is not written: the disk is full.")});
    EXPECT_EQ(told(), "a.mp4 is not written: the disk is full.");
    EXPECT_FALSE(button("showInFolder").isVisible());
    EXPECT_FALSE(button("sharedFileOpen").isVisible());
}

TEST_F(SharingTest, ALongNameLeavesTheWindowAsNarrowAsItWas) {
    const std::filesystem::path file = folder / (std::string(200, 'x') + ".mp4");
    window.animationBar().sharedFileEnded({file, true, KM_wString(L"x")});
    settle();
    const int narrowest = window.animationBar().minimumSizeHint().width();
    window.animationBar().sharedFileEnded({file, true, wideText(qtText(file))});
    settle();
    EXPECT_EQ(window.animationBar().minimumSizeHint().width(), narrowest);
    EXPECT_TRUE(told().contains(u'…'));
    window.animationBar().sharedFileProgress(file, 0.5);
    EXPECT_LT(part<QLabel>(window, "progressText").minimumSizeHint().width(), window.width() / 2);
}

TEST_F(SharingTest, NothingCanBeOpenedWhileACommandRuns) {
    makePage();
    bool was_free = true;
    QObject::connect(&window.starter(), &CommandStarter::started, &window, [&](const QString&) {
        later([&] {
            was_free = button("showInFolder").isEnabled() || button("sharedFileOpen").isEnabled();
            window.starter().stop();
            window.commandPane().cancelQuestion();
        });
    });
    run("_Circle");
    EXPECT_FALSE(was_free);
    EXPECT_TRUE(button("showInFolder").isEnabled());
}

/// What a person at the window is asked by Film and ViewerPage.
class SharingQuestionsTest : public WindowPartsTest {
protected:
    SharingQuestionsTest() {
        usePart([this](FrontEndParts& used) {
            used.choose_folder = [this](QWidget*, std::wstring_view, std::wstring_view,
                                        const std::filesystem::path& start) {
                first_folder = start;
                return chosen_folder;
            };
            used.choose_file = [this](QWidget*, const FileQuestion& question) {
                offered_file = question.start;
                return FileChoice{FileChoice::Kind::given_up, {}};
            };
            used.ask = [this](const Question& question) {
                prompts << qtText(question.prompt);
                return answer;
            };
        });
        setUpTurntable(2);
    }
    void setRecordedFolder(const std::filesystem::path& path) {
        KM_3dmAnimationProperties changed = record();
        changed.SetFolderName(wideText(qtText(path)));
        session.document().Properties().SetAnimationProperties(changed);
    }

    std::optional<std::filesystem::path> chosen_folder;
    std::filesystem::path first_folder;
    std::filesystem::path offered_file;
    QStringList prompts;
    Answer answer{Answer::Kind::cancel, {}};
};

TEST_F(SharingQuestionsTest, ChoosersOfFoldersBeginAtTheLastRecording) {
    for (const char* const line : {"ViewerPage", "Film"}) {
        setRecordedFolder({});
        starter.start(line);
        EXPECT_EQ(first_folder, folder.path()) << line << ": the folder for documents";
        setRecordedFolder(folder / "Turn");
        starter.start(line);
        EXPECT_EQ(first_folder, folder / "Turn") << line;
    }
}

TEST_F(SharingQuestionsTest, AFilmOfAChosenFolderIsOfferedBesideItsFrames) {
    chosen_folder = folder / "Turn";
    answer = {Answer::Kind::enter, {}};
    starter.start("Film");
    EXPECT_EQ(prompts, QStringList{"Save the film"});
    EXPECT_EQ(offered_file, folder / "Turn" / "Turn.mp4");
    EXPECT_EQ(last_result, CQuarnCommand::cancel);
}

TEST_F(SharingQuestionsTest, AClosedChooserLeavesTheQuestionAtTheCommandLine) {
    starter.start("Film");
    starter.start("ViewerPage");
    EXPECT_EQ(prompts, (QStringList{"Folder of the frames", "Folder with recorded frames"}));
    EXPECT_EQ(last_result, CQuarnCommand::cancel);
}

} // namespace
} // namespace quarn::desktop::test
