#pragma once

#include "host/document/file/DocumentCoding.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <utility>
#include <vector>

namespace quarn::test {

using Bytes = std::vector<std::uint8_t>;

/// A document file's bytes; none, with a failure told, where it cannot be written.
inline Bytes encoded(const DocumentContent& content) {
    auto bytes = encodeDocument(content);
    EXPECT_TRUE(bytes) << (bytes ? "" : bytes.message());
    return bytes ? bytes.value() : Bytes();
}

/// What a document file holds; nothing, with a failure told, where it cannot be read.
inline DocumentContent decoded(const Bytes& bytes) {
    auto content = decodeDocument(bytes);
    EXPECT_TRUE(content) << (content ? "" : content.message());
    return content ? std::move(content.value()) : DocumentContent();
}

} // namespace quarn::test
