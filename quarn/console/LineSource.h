#pragma once

#include "host/session/Completion.h"
#include "quarn/session/Interruption.h"

#include <chrono>
#include <functional>
#include <string>
#include <string_view>

namespace quarn::program {

/// A line that a person typed, or why there is none.
struct LineRead {
    enum class Kind {
        line,
        end,         ///< no further line comes
        lost,        ///< the terminal is gone
        interrupted, ///< Ctrl-C, or a request to terminate
    };
    Kind kind = Kind::end;
    std::wstring text; ///< without its line break
};

/// What a line is asked for: each purpose has lines of its own to call back.
enum class LineUse { command, answer };

/// Says what the text before the cursor may be completed to.
using Completer = std::function<Completion(std::wstring_view)>;

/// Where the lines come from that a person types.
class LineSource {
public:
    virtual ~LineSource() = default;

    /// Asks for one line.
    /// @param prompt  shown before the line
    virtual LineRead read(const std::wstring& prompt, LineUse use, const Completer& completer) = 0;

    /// Makes a line one that can be called back as if it had been typed.
    virtual void remember(std::wstring_view line, LineUse use) = 0;

    /// Whether a person is at the other end, who sees what they type.
    virtual bool isTerminal() const = 0;

    /// From now on this is done whenever nothing was typed for so long while a line is waited for;
    /// it must print nothing. Empty work ends that.
    void setIdleWork(std::function<void()> work, std::chrono::milliseconds between);

protected:
    /// As readInputByte, with the idle work meanwhile.
    InputByte waitForByte(int descriptor) const;

private:
    std::function<void()> m_idle_work;
    std::chrono::milliseconds m_between{};
};

} // namespace quarn::program
