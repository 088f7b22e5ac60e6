#pragma once

#include <cstdio>
#include <string_view>

namespace quarn::program {

/// One line of a terminal that is written over and over. Anything but a terminal is left alone.
class ProgressLine {
public:
    explicit ProgressLine(std::FILE* stream);
    ~ProgressLine() { clear(); }
    ProgressLine(const ProgressLine&) = delete;
    ProgressLine& operator=(const ProgressLine&) = delete;

    /// Whether anything is shown at all.
    bool isOnTerminal() const { return m_is_terminal; }
    /// Shows the text in place of the last one.
    void show(std::string_view text);
    /// Takes the line away, so that other text can be printed.
    void clear();

private:
    std::FILE* m_stream;
    bool m_is_terminal;
    bool m_is_shown = false;
};

} // namespace quarn::program
