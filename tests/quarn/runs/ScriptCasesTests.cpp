#include "tests/quarn/Pictures.h"
#include "tests/quarn/ProgramRun.h"

#include <algorithm>
#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

const std::filesystem::path CASES = std::filesystem::path(QUARN_SOURCE_DIR) / "tests" / "scripts";

/// Pictures may differ from machine to machine in the last bits of a few pixels.
constexpr double PICTURE_TOLERANCE = 0.004;

std::vector<std::string> caseNames() {
    std::vector<std::string> names;
    for (const auto& entry : std::filesystem::directory_iterator(CASES))
        if (entry.is_directory())
            names.push_back(entry.path().filename().string());
    std::sort(names.begin(), names.end());
    return names;
}

/// Whether a line is as expected; "{any}" stands for any text.
bool matches(std::string_view line, std::string_view expected) {
    constexpr std::string_view ANY = "{any}";
    const std::size_t any = expected.find(ANY);
    if (any == std::string_view::npos)
        return line == expected;
    if (!line.starts_with(expected.substr(0, any)))
        return false;
    const std::string_view rest = expected.substr(any + ANY.size());
    for (std::size_t at = any; at <= line.size(); ++at)
        if (matches(line.substr(at), rest))
            return true;
    return false;
}

/// All that a case ended with, as expected.txt holds it.
std::string transcript(const Ended& ended) {
    std::string text = ended.out;
    if (!ended.err.empty())
        text += "--- standard error\n" + ended.err;
    return text + "--- exit code " + std::to_string(ended.exit_code) + "\n";
}

void expectText(const std::string& text, const std::string& expected) {
    const auto lines = linesOf(text);
    const auto expected_lines = linesOf(expected);
    bool is_same = lines.size() == expected_lines.size();
    for (std::size_t i = 0; is_same && i < lines.size(); ++i)
        is_same = matches(lines[i], expected_lines[i]);
    EXPECT_TRUE(is_same) << "printed:\n" << text << "expected:\n" << expected;
}

void expectPictures(const std::filesystem::path& made, const std::filesystem::path& expected) {
    for (const std::string& name : filesIn(expected)) {
        const Picture picture = readBitmap(expected / name);
        ASSERT_FALSE(picture.bytes.empty()) << name << " is no bitmap";
        EXPECT_LT(meanDifference(readBitmap(made / name), picture), PICTURE_TOLERANCE) << name;
    }
}

std::vector<std::string> argumentsFor(const std::filesystem::path& folder) {
    std::vector<std::string> arguments = {"run", "--language", "en", "script.txt"};
    for (const std::string& name : filesIn(folder))
        if (name.starts_with("model."))
            arguments.push_back(name);
    return arguments;
}

/// A folder of tests/scripts: script.txt is run in a copy of the folder, after model.* where there
/// is one; what is printed must be expected.txt, and the bitmaps in pictures/ must be made.
class ScriptCase : public testing::TestWithParam<std::string> {};

TEST_P(ScriptCase, PrintsAndMakesWhatItsFolderHolds) {
    const std::filesystem::path expected = CASES / GetParam();
    const TempFolder folder;
    std::filesystem::copy(expected, folder.path(), std::filesystem::copy_options::recursive);
    std::filesystem::create_directory(folder / "out");
    Start start;
    start.folder = folder.path();
    start.arguments = argumentsFor(folder.path());
    expectText(transcript(run(start)), readFile(expected / "expected.txt"));
    if (std::filesystem::exists(expected / "pictures"))
        expectPictures(folder / "out", expected / "pictures");
}

INSTANTIATE_TEST_SUITE_P(Scripts, ScriptCase, testing::ValuesIn(caseNames()),
                         [](const auto& instance) {
                             std::string name = instance.param;
                             std::replace(name.begin(), name.end(), '-', '_');
                             return name;
                         });

} // namespace
} // namespace quarn::test
