#include "desktop/window/Language.h"
#include "tests/support/TempFolder.h"

#include <gtest/gtest.h>

#include <QProcess>

#include <clocale>
#include <filesystem>
#include <map>
#include <string>

namespace quarn::desktop {
namespace {

using quarn::test::readFile;
using quarn::test::TempFolder;
using quarn::test::writeFile;

constexpr const char* MODEL = "o Roof\nv -1.25 -1.5 0.125\nv 1.75 -1.5 0.375\nv 0.5 1.25 2.625\n"
                              "f 1 2 3\n";

/// Makes a locale with decimal commas. @return whether it could be made
bool makeLocale(const TempFolder& locales) {
    const std::string command =
        "localedef -i de_DE -f UTF-8 '" + (locales / "de_DE.UTF-8").string() + "' >/dev/null 2>&1";
    return std::system(command.c_str()) == 0;
}

/// A recording with numbers of all kinds in it.
constexpr const char* SCRIPT =
    "_-Import roof.obj\n"
    "_-ViewportSize 96 64\n"
    "_-Camera _Location 4.5,-5.25,3.75 _Target 0.25,0.5,0.75 _Lens 35.5 _Enter\n"
    "_-Sun _PlaceAndTime 48.14 11.58 \"2026-06-21 14:30\" _NorthAngle 12.5 _Enter\n"
    "_-AnimationName Roof\n"
    "_-SetTurntableAnimation 3 _Clockwise _png _RenderedViewport _Enter _Enter\n"
    "_-RecordAnimation _TargetFolder record _Enter\n";

class CommaCountry : public testing::Test {
protected:
    /// Runs the window in a folder of its own. @return the files of the recording
    std::map<std::string, std::string> recorded(const QStringList& environment) {
        const TempFolder folder;
        std::filesystem::create_directory(folder / "record");
        writeFile(folder / "roof.obj", MODEL);
        writeFile(folder / "script.txt", SCRIPT);
        QProcess window;
        window.setWorkingDirectory(QString::fromStdString(folder.path().string()));
        QProcessEnvironment surroundings = QProcessEnvironment::systemEnvironment();
        surroundings.remove("LC_ALL");
        surroundings.insert("HOME", window.workingDirectory());
        surroundings.insert("QT_QPA_PLATFORM", "offscreen");
        QStringList all = surroundings.toStringList();
        window.setEnvironment(all << environment);
        window.setProcessChannelMode(QProcess::ForwardedErrorChannel);
        window.start(QUARN_DESKTOP_PROGRAM,
                     {"--language", "en", "--run-script", "script.txt", "--exit"});
        EXPECT_TRUE(window.waitForFinished(60000));
        EXPECT_EQ(window.exitCode(), 0);
        return filesOf(folder.path());
    }

    static std::map<std::string, std::string> filesOf(const std::filesystem::path& folder) {
        std::map<std::string, std::string> files;
        for (const auto& entry : std::filesystem::recursive_directory_iterator(folder)) {
            const std::string extension = entry.path().extension().string();
            if (extension == ".png" || extension == ".html")
                files[entry.path().lexically_relative(folder).string()] = readFile(entry.path());
        }
        return files;
    }
};

TEST_F(CommaCountry, WindowRecordsTheSameFramesAndPage) {
    const TempFolder locales;
    ASSERT_TRUE(makeLocale(locales));
    const auto with_point = recorded({"LC_NUMERIC=C"});
    const auto with_comma = recorded(
        {QString::fromStdString("LOCPATH=" + locales.path().string()), "LC_NUMERIC=de_DE.UTF-8"});
    EXPECT_EQ(with_point.size(), 4U); // three frames and the page
    ASSERT_EQ(with_comma.size(), with_point.size());
    for (const auto& [name, bytes] : with_point)
        EXPECT_TRUE(with_comma.contains(name) && with_comma.at(name) == bytes) << name;
}

TEST(CommaCountryNumbers, AreWrittenWithAPointByTheCLibraryOnceTheLanguageIsChosen) {
    const TempFolder locales;
    ASSERT_TRUE(makeLocale(locales));
    qputenv("LOCPATH", locales.path().c_str());
    const char* const with_comma = std::setlocale(LC_NUMERIC, "de_DE.UTF-8");
    qunsetenv("LOCPATH");
    ASSERT_NE(with_comma, nullptr);
    ASSERT_STREQ(std::localeconv()->decimal_point, ",");
    const Language language("de");
    EXPECT_STREQ(std::localeconv()->decimal_point, ".");
}

} // namespace
} // namespace quarn::desktop
