#pragma once

#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

namespace quarn::program {

/// The file that keeps what was typed for the next run: one line each, UTF-8, the oldest first.
/// Where it cannot be read or written there is no history, and nothing else is amiss.
class HistoryFile {
public:
    /// How many lines are kept from one run to the next.
    static constexpr std::size_t LINES_KEPT = 1000;

    /// @param file  empty: nothing is kept
    explicit HistoryFile(std::filesystem::path file);

    /// The lines of earlier runs.
    std::vector<std::wstring> load() const;

    /// Appends a line at once, so that nothing is lost however the program ends, and so that
    /// programs that run side by side keep each other's lines.
    void append(std::wstring_view line) const;

private:
    std::filesystem::path m_file;
};

/// `history` in the user's folder for state (userStateFolder); empty where there is none.
std::filesystem::path historyPath();

} // namespace quarn::program
