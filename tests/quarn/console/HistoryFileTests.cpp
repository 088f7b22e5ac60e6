#include "quarn/console/HistoryFile.h"
#include "tests/support/TempFolder.h"

#include <cstdlib>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <optional>

namespace quarn::test {
namespace {

using program::HistoryFile;
using program::historyPath;
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

TEST(HistoryFile, KeepsLinesOfAnyLanguageInTheirOrder) {
    const TempFolder folder;
    const std::filesystem::path file = folder / "state/quarn/history";
    EXPECT_THAT(HistoryFile(file).load(), IsEmpty());
    HistoryFile(file).append(L"List");
    HistoryFile(file).append(L"Import \"größe 一.obj\"");
    EXPECT_THAT(HistoryFile(file).load(), ElementsAre(L"List", L"Import \"größe 一.obj\""));
}

TEST(HistoryFile, IsForTheUserAlone) {
    using std::filesystem::perms;
    const TempFolder folder;
    HistoryFile(folder / "state/history").append(L"List");
    const auto mode = [&](const char* name) {
        return std::filesystem::status(folder / name).permissions();
    };
    EXPECT_EQ(mode("state"), perms::owner_all);
    EXPECT_EQ(mode("state/history"), perms::owner_read | perms::owner_write);
}

TEST(HistoryFile, WithoutAFolderIsEmpty) {
    const TempFolder folder;
    writeFile(folder / "file", "");
    for (const std::filesystem::path& file :
         {std::filesystem::path(), folder / "file" / "history"}) {
        HistoryFile(file).append(L"List");
        EXPECT_THAT(HistoryFile(file).load(), IsEmpty());
    }
}

TEST(HistoryFile, ThatIsALinkStaysOneWhenItForgets) {
    const TempFolder folder;
    std::string text;
    for (std::size_t i = 0; i <= HistoryFile::LINES_KEPT; ++i)
        text += "Line\n";
    writeFile(folder / "kept elsewhere", text);
    std::filesystem::create_symlink("kept elsewhere", folder / "history");
    EXPECT_THAT(HistoryFile(folder / "history").load(), SizeIs(HistoryFile::LINES_KEPT));
    EXPECT_TRUE(std::filesystem::is_symlink(folder / "history"));
    EXPECT_EQ(readFile(folder / "kept elsewhere").size(), 5 * HistoryFile::LINES_KEPT);
}

TEST(HistoryFile, ForgetsTheOldestLines) {
    const TempFolder folder;
    std::string text;
    for (std::size_t i = 0; i <= HistoryFile::LINES_KEPT; ++i)
        text += "Line" + std::to_string(i) + "\n";
    writeFile(folder / "history", text);
    const auto lines = HistoryFile(folder / "history").load();
    ASSERT_THAT(lines, SizeIs(HistoryFile::LINES_KEPT));
    EXPECT_EQ(lines.front(), L"Line1");
    EXPECT_EQ(lines.back(), L"Line1000");
    EXPECT_TRUE(readFile(folder / "history").starts_with("Line1\n"));
    EXPECT_EQ(std::distance(std::filesystem::directory_iterator(folder.path()), {}), 1);
}

TEST(HistoryFile, StandsInTheFolderForState) {
    const Variable home("HOME", "/home/ada");
    const Variable state("XDG_STATE_HOME", "/state");
    EXPECT_EQ(historyPath(), "/state/quarn/history");
    for (const char* unusable : {"", "relative/state"}) {
        const Variable no_state("XDG_STATE_HOME", unusable);
        EXPECT_EQ(historyPath(), "/home/ada/.local/state/quarn/history");
        const Variable no_home("HOME", "");
        EXPECT_EQ(historyPath(), "");
    }
}

} // namespace
} // namespace quarn::test
