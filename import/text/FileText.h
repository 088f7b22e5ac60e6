#pragma once

#include "ground/Result.h"
#include "import/ReadingBudget.h"

#include <cstdint>
#include <span>
#include <string>
#include <string_view>

namespace quarn {

/// The text of a file in UTF-8: its own bytes without a byte order mark, or made of those in
/// UTF-16.
class FileText {
public:
    /// @param bytes  of the file; outlive this object
    /// @return an error, a part of a sentence, where the budget does not hold the text
    static Result<FileText> of(std::span<const std::uint8_t> bytes, ReadingBudget& budget);

    /// Valid as long as this object, wherever it moves.
    std::string_view text() const { return m_made.empty() ? m_own : std::string_view(m_made); }

private:
    std::string_view m_own;
    std::string m_made;
};

} // namespace quarn
