#include "import/files/FileEnd.h"

#include <algorithm>

namespace quarn {

std::string_view endOfFile(std::span<const std::uint8_t> bytes) {
    constexpr std::size_t MOST = 400;
    const std::size_t count = std::min(bytes.size(), MOST);
    return {reinterpret_cast<const char*>(bytes.data() + bytes.size() - count), count};
}

} // namespace quarn
