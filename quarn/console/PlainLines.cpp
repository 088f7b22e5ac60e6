#include "quarn/console/PlainLines.h"

#include "quarn/terminal/ShownText.h"
#include "quarn/words/Words.h"

#include <cstdio>

namespace quarn::program {

namespace {

void show(const std::string& words) {
    const std::string text = shownText(words);
    std::fwrite(text.data(), 1, text.size(), stdout);
    std::fflush(stdout);
}

LineRead lineOf(std::string bytes) {
    if (bytes.ends_with('\r'))
        bytes.pop_back();
    show(bytes + "\n");
    return {LineRead::Kind::line, wideText(bytes)};
}

LineRead noLine(LineRead::Kind why) {
    show("\n");
    return {why, {}};
}

} // namespace

LineRead PlainLines::read(const std::wstring& prompt, LineUse, const Completer&) {
    show(utf8Text(prompt));
    std::string bytes;
    for (;;) {
        const InputByte input = waitForByte(m_descriptor);
        if (input.kind == InputByte::Kind::interrupted)
            return noLine(LineRead::Kind::interrupted);
        if (input.kind == InputByte::Kind::end && bytes.empty())
            return noLine(LineRead::Kind::end);
        if (input.kind == InputByte::Kind::end || input.byte == '\n')
            return lineOf(std::move(bytes));
        if (input.kind == InputByte::Kind::byte)
            bytes += static_cast<char>(input.byte);
    }
}

} // namespace quarn::program
