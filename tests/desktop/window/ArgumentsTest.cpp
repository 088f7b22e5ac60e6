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

TEST(Arguments, TheBeatOfRecoveryIsReadInSecondsAndTheirFractions) {
    EXPECT_EQ(readArguments({"quarn-desktop"}).recovery_every, std::chrono::seconds(10));
    EXPECT_EQ(readArguments({"quarn-desktop", "--recovery-every", "0.25"}).recovery_every,
              std::chrono::milliseconds(250));
    for (const char* const none : {"0", "-1", "nan", "often", "0.09", "3601", ""})
        EXPECT_FALSE(readArguments({"quarn-desktop", "--recovery-every", none}).mistake.isEmpty())
            << none;
}

TEST(Arguments, TheMemoryThatReadingMayTakeIsASize) {
    EXPECT_EQ(readArguments({"quarn-desktop"}).most_memory, 0U);
    EXPECT_EQ(readArguments({"quarn-desktop", "--limit-memory", "2G"}).most_memory, 2ULL << 30);
    EXPECT_EQ(readArguments({"quarn-desktop", "--limit-memory", "500m"}).most_memory, 500U << 20);
    for (const char* const none : {"", "0M", "2", "two", "-1G", "2GB"})
        EXPECT_FALSE(readArguments({"quarn-desktop", "--limit-memory", none}).mistake.isEmpty())
            << none;
}

TEST(Arguments, RecoveryIsWantedWhereNobodyRefusesIt) {
    EXPECT_TRUE(readArguments({"quarn-desktop"}).wants_recovery);
    EXPECT_FALSE(readArguments({"quarn-desktop", "--no-recovery"}).wants_recovery);
}

TEST(Arguments, HelpAndVersionAreAnswered) {
    EXPECT_TRUE(readArguments({"quarn-desktop", "--help"}).answer.contains("--run-script"));
    EXPECT_TRUE(readArguments({"quarn-desktop", "--version"}).answer.startsWith("quarn-desktop "));
}

} // namespace
} // namespace quarn::desktop
