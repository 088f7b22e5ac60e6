#pragma once

#include "ground/FileBytes.h"
#include "import/ModelReading.h"
#include "import/gltf/GltfJson.h"

#include <cstdint>
#include <map>
#include <string>
#include <vector>

namespace quarn::gltf {

/// The bytes of a file: its buffers, and the views into them, decoded where they are compressed.
/// Each is had on demand, once.
class Buffers {
public:
    /// @param json      of the file; like the others it outlives this object
    /// @param binary    of a GLB
    /// @param warnings  receives sentences
    Buffers(const ModelReading& reading, const Json& json, Bytes binary,
            std::vector<std::string>& warnings)
        : m_reading(reading), m_json(json), m_binary(binary), m_warnings(warnings) {}

    /// The bytes of a view. They are valid as long as this object.
    /// @return an error that names the file
    Result<Bytes> view(std::uint64_t index);
    /// The distance from one element to the next that a view states, or 0.
    std::uint64_t stride(std::uint64_t view) const;

    /// The bytes of a data: URI.
    /// @param what  names their owner to the person: "buffer 2"
    /// @return an error that names the file
    Result<Bytes> fromDataUri(const std::string& what, std::string_view uri);

private:
    Result<Bytes> buffer(std::uint64_t index);
    Result<Bytes> readBuffer(std::uint64_t index);
    Result<Bytes> readFile(const std::string& what, const std::string& uri);
    Result<Bytes> part(const Json& place, const std::string& what);
    Result<Bytes> decompressed(const Json& compressed, const std::string& what);

    const ModelReading& m_reading;
    const Json& m_json;
    Bytes m_binary;
    std::vector<std::string>& m_warnings;
    std::map<std::uint64_t, Bytes> m_buffers;
    std::map<std::uint64_t, Bytes> m_views; ///< the compressed ones
    std::vector<MappedFile> m_files;
    std::vector<std::vector<std::uint8_t>> m_decoded;
};

/// True where elements of `size` bytes, `stride` apart from each other, lie within `length` bytes.
bool fits(std::uint64_t offset, std::uint64_t count, std::uint64_t stride, std::uint64_t size,
          std::uint64_t length);

} // namespace quarn::gltf
