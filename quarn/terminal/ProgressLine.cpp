#include "quarn/terminal/ProgressLine.h"

#include "quarn/terminal/ShownText.h"

#include <unistd.h>

namespace quarn::program {

ProgressLine::ProgressLine(std::FILE* stream)
    : m_stream(stream), m_is_terminal(isatty(fileno(stream)) == 1) {}

void ProgressLine::show(std::string_view text) {
    if (!m_is_terminal)
        return;
    std::fprintf(m_stream, "\r%s\x1b[K", shownText(text).c_str());
    std::fflush(m_stream);
    m_is_shown = true;
}

void ProgressLine::clear() {
    if (!m_is_shown)
        return;
    std::fputs("\r\x1b[K", m_stream);
    std::fflush(m_stream);
    m_is_shown = false;
}

} // namespace quarn::program
