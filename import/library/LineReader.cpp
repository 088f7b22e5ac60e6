#include "import/library/LineReader.h"

#include <cstring>

namespace quarn {

namespace {
constexpr std::size_t first_size = std::size_t{1} << 18;
}

LineReader::LineReader(const std::filesystem::path& path)
    : m_file(path, std::ios::binary), m_bytes(first_size) {}

bool LineReader::next(std::string_view& line) {
    std::size_t searched = m_at;
    while (true) {
        const void* const found = std::memchr(&m_bytes[0] + searched, '\n', m_end - searched);
        if (found != nullptr) {
            const auto length =
                static_cast<std::size_t>(static_cast<const char*>(found) - (&m_bytes[0] + m_at));
            line = {&m_bytes[0] + m_at, length};
            m_at += length + 1;
            ++m_number;
            return true;
        }
        const std::size_t known = m_end - m_at;
        readMore();
        if (m_end - m_at == known) {
            line = {&m_bytes[0] + m_at, known};
            m_at = m_end;
            m_number += known > 0 ? 1 : 0;
            return known > 0;
        }
        searched = m_at + known;
    }
}

/// Moves what is left of the line to the front; a line that fills all of the memory gets more.
void LineReader::readMore() {
    const std::size_t known = m_end - m_at;
    std::memmove(&m_bytes[0], &m_bytes[0] + m_at, known);
    if (known == m_bytes.size()) {
        m_bytes.resize(2 * m_bytes.size());
    }
    m_file.read(&m_bytes[0] + known, static_cast<std::streamsize>(m_bytes.size() - known));
    m_at = 0;
    m_end = known + static_cast<std::size_t>(m_file.gcount());
}

} // namespace quarn
