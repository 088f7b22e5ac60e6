#pragma once

#include "engine/images/ImageFile.h"
#include "ground/Result.h"

#include <cstddef>
#include <cstdint>
#include <vector>

namespace quarn {

/// Makes PNG files. Keeps its row of pixels; what the library needs it asks for anew each time.
class PngEncoder {
public:
    /// Appends a PNG file of the picture to `bytes`.
    /// @return why it cannot be made, a part of a sentence
    Result<void> encode(const ImageView& image, std::vector<std::byte>& bytes);

private:
    std::vector<std::uint8_t> m_row;
};

} // namespace quarn
