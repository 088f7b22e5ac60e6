#include "desktop/window/Arguments.h"

#include <gtest/gtest.h>

namespace quarn::desktop {
namespace {

TEST(Arguments, FileLanguageAndScriptAreRead) {
    const Arguments read =
        readArguments({"quarn-desktop", "--language", "de", "house.obj", "--run-script", "a.txt"});
    EXPECT_EQ(read.file, "house.obj");
    EXPECT_EQ(read.language, "de");
    EXPECT_EQ(read.script, "a.txt");
    EXPECT_FALSE(read.wants_exit);
    EXPECT_TRUE(read.mistake.isEmpty());
}

TEST(Arguments, UnknownOptionAndSecondFileAreMistakes) {
    EXPECT_TRUE(readArguments({"quarn-desktop", "--speed"}).mistake.contains("speed"));
    EXPECT_FALSE(readArguments({"quarn-desktop", "a.obj", "b.obj"}).mistake.isEmpty());
}

TEST(Arguments, HelpAndVersionAreAnswered) {
    EXPECT_TRUE(readArguments({"quarn-desktop", "--help"}).answer.contains("--run-script"));
    EXPECT_TRUE(readArguments({"quarn-desktop", "--version"}).answer.startsWith("quarn-desktop "));
}

} // namespace
} // namespace quarn::desktop
