#include "quarn/LineHistory.h"
#include "tests/support/TempFolder.h"

#include <cstdlib>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <optional>

namespace quarn::test {
namespace {

using program::historyFile;
using program::LineHistory;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

/// A variable of the environment that has another value for a while.
class Variable {
public:
    Variable(const char* name, const std::string& value) : m_name(name) {
        if (const char* const before = std::getenv(name))
            m_before = before;
        setenv(name, value.c_str(), 1);
    }
    ~Variable() {
        if (m_before)
            setenv(m_name, m_before->c_str(), 1);
        else
            unsetenv(m_name);
    }

private:
    const char* m_name;
    std::optional<std::string> m_before;
};

TEST(LineHistory, KeepsLinesOfAnyLanguageInTheirOrder) {
    const TempFolder folder;
    const std::filesystem::path file = folder / "state/quarn/history";
    EXPECT_THAT(LineHistory(file).load(), IsEmpty());
    LineHistory(file).append(L"List");
    LineHistory(file).append(L"Import \"größe 一.obj\"");
    EXPECT_THAT(LineHistory(file).load(), ElementsAre(L"List", L"Import \"größe 一.obj\""));
}

TEST(LineHistory, IsForTheUserAlone) {
    using std::filesystem::perms;
    const TempFolder folder;
    LineHistory(folder / "state/history").append(L"List");
    const auto mode = [&](const char* name) {
        return std::filesystem::status(folder / name).permissions();
    };
    EXPECT_EQ(mode("state"), perms::owner_all);
    EXPECT_EQ(mode("state/history"), perms::owner_read | perms::owner_write);
}

TEST(LineHistory, WithoutAFolderIsEmpty) {
    const TempFolder folder;
    writeFile(folder / "file", "");
    for (const std::filesystem::path& file :
         {std::filesystem::path(), folder / "file" / "history"}) {
        LineHistory(file).append(L"List");
        EXPECT_THAT(LineHistory(file).load(), IsEmpty());
    }
}

TEST(LineHistory, ForgetsTheOldestLines) {
    const TempFolder folder;
    std::string text;
    for (std::size_t i = 0; i <= LineHistory::LINES_KEPT; ++i)
        text += "Line" + std::to_string(i) + "\n";
    writeFile(folder / "history", text);
    const auto lines = LineHistory(folder / "history").load();
    ASSERT_THAT(lines, SizeIs(LineHistory::LINES_KEPT));
    EXPECT_EQ(lines.front(), L"Line1");
    EXPECT_EQ(lines.back(), L"Line1000");
    EXPECT_TRUE(readFile(folder / "history").starts_with("Line1\n"));
    EXPECT_EQ(std::distance(std::filesystem::directory_iterator(folder.path()), {}), 1);
}

TEST(LineHistory, StandsInTheFolderForState) {
    const Variable home("HOME", "/home/ada");
    const Variable state("XDG_STATE_HOME", "/state");
    EXPECT_EQ(historyFile(), "/state/quarn/history");
    for (const char* unusable : {"", "relative/state"}) {
        const Variable no_state("XDG_STATE_HOME", unusable);
        EXPECT_EQ(historyFile(), "/home/ada/.local/state/quarn/history");
        const Variable no_home("HOME", "");
        EXPECT_EQ(historyFile(), "");
    }
}

} // namespace
} // namespace quarn::test
