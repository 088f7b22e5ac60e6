#pragma once

#include "engine/images/ImageFile.h"
#include "ground/Result.h"

#include <cstddef>
#include <span>

namespace quarn {

/// Makes JPEG files: quality 90, 4:4:4. Keeps its compressor and its buffer.
class JpegEncoder {
public:
    JpegEncoder() = default;
    ~JpegEncoder();
    JpegEncoder(const JpegEncoder&) = delete;
    JpegEncoder& operator=(const JpegEncoder&) = delete;

    /// @return bytes that are valid until the next call; or why not, a part of a sentence
    Result<std::span<const std::byte>> encode(const ImageView& image);

private:
    bool makeRoom(const ImageView& image);

    void* m_compressor = nullptr;
    unsigned char* m_buffer = nullptr;
    unsigned long m_capacity = 0;
};

} // namespace quarn
