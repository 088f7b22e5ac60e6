#include "tests/vexui/VexUiFixture.h"
#include "tests/vexui/WithoutWindows.h"

#include <dlfcn.h>

#include <cstdio>
#include <fstream>

using testing::HasSubstr;
using testing::Not;

namespace {

class Loading : public VexUiFixture {
protected:
    static bool isFileOpen() {
        void* const library = dlopen(VEXUI_PLUGIN_PATH, RTLD_LAZY | RTLD_NOLOAD);
        if (library)
            dlclose(library);
        return library != nullptr;
    }
    static std::pair<int, std::string> outputOf(const std::string& command) {
        FILE* const pipe = popen((command + " 2>&1").c_str(), "r");
        std::string output;
        for (int c = std::fgetc(pipe); c != EOF; c = std::fgetc(pipe))
            output += static_cast<char>(c);
        return {pclose(pipe), output};
    }
    static std::string ownProgram() {
        return std::filesystem::read_symlink("/proc/self/exe").string();
    }
};

} // namespace

TEST_F(Loading, ThePlugInIsTheOneThatTheHostKnowsByItsId) {
    EXPECT_TRUE(CQuarnPlugIn::PlugInIsLoaded(ZelVexUiPlugInId));
    EXPECT_NE(nullptr, QnZoetrixVexUiTurnTable());
    EXPECT_NE(nullptr, QnZoetrixVexUiPathAnimation());
    EXPECT_NE(nullptr, QnZoetrixVexUiDay());
    EXPECT_NE(nullptr, QnZoetrixVexUiSeason());
}

TEST_F(Loading, ACommandLoadsItWhenItIsNeeded) {
    session.reset();
    session = std::make_unique<quarn::Session>(front_end, vexUiOptions(folder.path(), "C"));
    ASSERT_TRUE(session->loadPlugIn(ZOETRIX_PLUGIN_PATH).ok());
    EXPECT_FALSE(CQuarnPlugIn::PlugInIsLoaded(ZelVexUiPlugInId));
    next([](QDialog& form) { form.reject(); });
    EXPECT_EQ(CQuarnCommand::cancel, session->runCommand(L"SetTurntableAnimation", true));
    EXPECT_TRUE(CQuarnPlugIn::PlugInIsLoaded(ZelVexUiPlugInId));
}

TEST_F(Loading, UnloadedAfterUseItLeavesNothingBehind) {
    for (int round = 0; round < 3; ++round) {
        front_end.addLocationChoice(quarn::Place{1.0, 2.0});
        EXPECT_TRUE(openTurntable([](QDialog& form) {
            typeInto(form, "frames", "0");
            typeInto(form, "frames", "9");
            QTest::keyClick(&field<QComboBox>(form, "viewport"), Qt::Key_F4);
            QTest::keyClick(&field<QComboBox>(form, "viewport"), Qt::Key_F4);
            form.accept();
        }));
        EXPECT_TRUE(openDay([](QDialog& form) {
            click(form, "choosePlace");
            form.accept();
        }));
        EXPECT_TRUE(openSeason([](QDialog& form) {
            QTest::keyClick(&field<QDateEdit>(form, "startDate"), Qt::Key_F4);
            QTest::qWait(10);
            if (QWidget* calendar = QApplication::activePopupWidget())
                calendar->close();
            form.accept();
        }));
        EXPECT_TRUE(isFileOpen());
        EXPECT_TRUE(QApplication::allWidgets().isEmpty());
        session.reset();
        EXPECT_FALSE(isFileOpen());
        // What the forms had left to do would be done now, in code that is gone.
        QTest::qWait(50);
        QApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
        start("C");
    }
}

TEST_F(Loading, WithoutQtsApplicationItRefusesAndTheCommandsSayWhatTheySayWithoutIt) {
    const auto [status, output] = outputOf("'" + ownProgram() + "' " + WITHOUT_WINDOWS);
    EXPECT_EQ(0, status) << output;
    EXPECT_THAT(output, Not(HasSubstr("Vex UI was not loaded"))) << "they load it quietly";
    EXPECT_THAT(output, HasSubstr("[Animation] Vex UI (ZEL_VexUI.qnp) cannot be loaded.\n"));
}

TEST_F(Loading, TheProgramOfTheCommandLineIsNoneWithWindows) {
    const std::filesystem::path script = folder / "load.txt";
    std::ofstream(script) << "LoadPlugIn \"" << VEXUI_PLUGIN_PATH << "\"\n";
    const auto [status, output] =
        outputOf("'" + std::string(QUARN_PROGRAM) + "' run '" + script.string() + "'");
    EXPECT_EQ(1, WEXITSTATUS(status)) << output;
    EXPECT_THAT(output, HasSubstr("Vex UI was not loaded: this program shows no windows.\n"));
}
