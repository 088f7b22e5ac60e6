#include "quarn/farm/ProgramRunner.h"
#include "quarn/words/Words.h"
#include "tests/quarn/ProgramRun.h"

#include <algorithm>
#include <gtest/gtest.h>

namespace quarn::program {
namespace {

const std::vector<std::string> WORDS = {"plain",
                                        "two words",
                                        "",
                                        "it's",
                                        "\"quoted\"",
                                        "$(touch pwned)",
                                        "`touch pwned`",
                                        "$HOME ${x} ~ ~root *?[a] {a,b}",
                                        "-x",
                                        "--opt=$(x)",
                                        "a\nb # no comment",
                                        "\x01\x1b[31m\t\x7f'\"\\x41 $(x)\n",
                                        "back\\slash\\",
                                        "!history;&|<>()",
                                        "%a%%",
                                        "Größe \xff"};

TEST(ShellWord, IsReadByBashAsTheBytesThatItWasMadeOf) {
    for (const std::string& word : WORDS) {
        const ProgramEnd end = runProgram({"bash", "-c", "printf %s " + shellWord(word)});
        EXPECT_EQ(end.out, word) << shellWord(word);
        EXPECT_TRUE(end.ok()) << end.err;
    }
}

TEST(ShellWord, NeverEndsALine) {
    for (const std::string& word : WORDS)
        EXPECT_EQ(shellWord(word).find('\n'), std::string::npos) << shellWord(word);
}

TEST(ShellCommand, GivesAProgramEachWordAlone) {
    std::vector<std::string> words = {"printf", "<%s>"};
    std::string expected;
    for (const std::string& word : WORDS) {
        words.push_back(word);
        expected += "<" + word + ">";
    }
    EXPECT_EQ(runProgram({"bash", "-c", shellCommand(words)}).out, expected);
}

// ---- The runner of programs

TEST(RunProgram, GivesWordsToTheProgramWithoutAShell) {
    for (const std::string& word : WORDS)
        EXPECT_EQ(runProgram({"printf", "%s", word}).out, word);
}

TEST(RunProgram, KeepsWhatAProgramSaysOnBothWaysAndItsExitCode) {
    const ProgramEnd end = runProgram({"bash", "-c", "echo out; echo err >&2; exit 7"});
    EXPECT_EQ(end.out, "out\n");
    EXPECT_EQ(end.err, "err\n");
    EXPECT_EQ(end.exit_code, 7);
    EXPECT_FALSE(end.ok());
}

TEST(RunProgram, TellsThatAProgramIsNotThere) {
    const ProgramEnd end = runProgram({"no-program-of-this-name"});
    EXPECT_FALSE(end.is_here);
    EXPECT_FALSE(end.ok());
    EXPECT_TRUE(isProgramHere("bash"));
    EXPECT_FALSE(isProgramHere("no-program-of-this-name"));
}

TEST(RunProgram, EndsAProgramThatTakesTooLong) {
    const ProgramEnd end = runProgram({"sleep", "60"}, std::chrono::seconds(1));
    EXPECT_TRUE(end.is_late);
    EXPECT_FALSE(end.ok());
}

TEST(RunProgram, TakesMoreOutputThanAPipeHolds) {
    EXPECT_EQ(runProgram({"head", "-c", "300000", "/dev/zero"}).out.size(), 300000u);
}

} // namespace
} // namespace quarn::program
