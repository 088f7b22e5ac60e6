#pragma once

#include "quarn/console/LineSource.h"
#include "quarn/session/ConsoleFrontEnd.h"

namespace quarn::program {

/// The front end of a person at a command line: every question is asked there.
class TerminalFrontEnd final : public ConsoleFrontEnd {
public:
    /// @param lines  what the person types; must outlive this
    explicit TerminalFrontEnd(LineSource& lines, Prints prints)
        : ConsoleFrontEnd(prints), m_lines(lines) {}

    /// Asks for one line, without blanks around it; an empty one is not kept to be called back.
    LineRead readLine(const std::wstring& prompt, LineUse use, const Completer& completer);

    Answer ask(const Question& question) override;
    std::optional<std::filesystem::path>
    chooseFolder(std::wstring_view title, std::wstring_view message,
                 const std::filesystem::path& start_folder) override;
    /// Asks for a city, or for a latitude and a longitude, until it is one or the person gives up.
    std::optional<Place> chooseLocation(std::wstring_view title, const Place& start) override;
    void pumpEvents(unsigned milliseconds) override;
    bool isKeyDown(int virtual_key) override;

private:
    LineSource& m_lines;
};

} // namespace quarn::program
