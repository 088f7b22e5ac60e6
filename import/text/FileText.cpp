#include "import/text/FileText.h"

#include "import/text/LineCursor.h"
#include "import/text/WideText.h"

#include <utility>

namespace quarn {

namespace {

/// Wide characters take four bytes for two of the file, and up to three and as many again for
/// their UTF-8.
constexpr std::uint64_t BYTES_FOR_A_BYTE = 5;

bool mayBeWide(std::span<const std::uint8_t> bytes) {
    return bytes.size() >= 2 && (bytes[0] == 0xFE || bytes[0] == 0xFF);
}

} // namespace

Result<FileText> FileText::of(std::span<const std::uint8_t> bytes, ReadingBudget& budget) {
    FileText file;
    file.m_own = withoutByteOrderMark(textOf(bytes));
    if (!mayBeWide(bytes))
        return file;
    if (const Result<void> taken = budget.take(BYTES_FOR_A_BYTE * bytes.size(), "characters");
        !taken)
        return taken.error();
    if (std::optional<std::string> made = utf8OfWideText(bytes))
        file.m_made = std::move(*made);
    return file;
}

} // namespace quarn
