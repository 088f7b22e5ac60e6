#pragma once

#include "quarn/console/LineSource.h"

namespace quarn::program {

/// Lines of a pipe or a file. What is read is shown behind its prompt, so that the output reads as
/// if somebody had typed it.
class PlainLines final : public LineSource {
public:
    /// @param descriptor  to read from; stays open
    explicit PlainLines(int descriptor) : m_descriptor(descriptor) {}

    LineRead read(const std::wstring& prompt, LineUse use, const Completer& completer) override;
    void remember(std::wstring_view, LineUse) override {}
    bool isTerminal() const override { return false; }

private:
    int m_descriptor;
};

} // namespace quarn::program
