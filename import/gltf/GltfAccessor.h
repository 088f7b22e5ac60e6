#pragma once

#include "import/gltf/GltfBuffers.h"

#include <cstdint>
#include <map>
#include <memory>
#include <span>
#include <string>
#include <vector>

namespace quarn::gltf {

/// The type of a number, by the value that files have for it.
enum class ComponentType {
    int8 = 5120,
    uint8 = 5121,
    int16 = 5122,
    uint16 = 5123,
    uint32 = 5125,
    float32 = 5126,
};

/// @return 0 for a value that is none of them
std::size_t sizeOf(ComponentType type);

/// Elements of one to sixteen numbers each, all of which lie where bytes are. Cheap to copy; valid
/// as long as the Accessors that it came from, or as what it owns.
struct Accessor {
    std::string name; ///< for messages: "accessor 3"
    Bytes bytes;      ///< from the first element on; none: all numbers are zero
    std::uint64_t count = 0;
    std::uint64_t stride = 0; ///< bytes
    ComponentType type = ComponentType::float32;
    unsigned components = 0;
    bool is_normalized = false; ///< integers stand for 0 to 1, or -1 to 1
    std::shared_ptr<const std::vector<std::uint8_t>> owned; ///< null: the bytes are another's

    /// The first numbers of an element.
    /// @param element  less than the count
    /// @param numbers  at most as many as an element has
    void read(std::uint64_t element, std::span<float> numbers) const;
    /// The first number of an element of integers; 0 for others.
    std::uint32_t index(std::uint64_t element) const { return integer(element, 0); }
    std::uint32_t integer(std::uint64_t element, unsigned component) const;
};

/// The accessors of a file.
class Accessors {
public:
    Accessors(const ModelReading& reading, const Json& json, Buffers& buffers)
        : m_reading(reading), m_json(json), m_buffers(buffers) {}

    /// @param which   the number of the accessor, as the file has it
    /// @param needed  how many numbers an element must have at least
    /// @return an error that names the file and the accessor
    Result<Accessor> at(const Json& which, unsigned needed);
    /// What an accessor says of itself alone; its bytes may stand elsewhere.
    Result<Accessor> described(const Json& which) const;

private:
    Result<Bytes> elementBytes(std::uint64_t view, std::uint64_t offset, std::uint64_t count,
                               std::uint64_t stride, std::uint64_t size, const std::string& what);
    Result<void> locate(const Json& json, Accessor& accessor);
    Result<void> overlay(const Json& sparse, Accessor& accessor);
    Result<Accessor> sparseIndices(const Json& sparse, const Accessor& accessor);

    const ModelReading& m_reading;
    const Json& m_json;
    Buffers& m_buffers;
    std::map<std::uint64_t, Accessor> m_sparse; ///< the sparse ones, put together
};

} // namespace quarn::gltf
