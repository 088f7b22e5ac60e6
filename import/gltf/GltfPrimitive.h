#pragma once

#include "import/gltf/GltfAccessor.h"

#include <optional>
#include <vector>

namespace quarn::gltf {

/// How the vertices of a primitive follow each other, by the value that files have for it.
enum class PrimitiveMode { points, lines, line_loop, line_strip, triangles, strip, fan };

/// Which joints move a vertex, and how much: four of each in an element.
struct Influences {
    Accessor joints;
    Accessor weights;
};

/// What is added to the vertices, as much as a weight says.
struct MorphTarget {
    std::optional<Accessor> positions;
    std::optional<Accessor> normals;
};

/// What a primitive of a mesh consists of. All accessors of vertices have as many elements as the
/// positions.
struct Primitive {
    PrimitiveMode mode = PrimitiveMode::triangles;
    Accessor positions;
    std::optional<Accessor> normals;
    std::optional<Accessor> texture_coordinates;
    std::optional<Accessor> colors;
    std::vector<Influences> influences;
    std::vector<MorphTarget> targets;
    std::optional<Accessor> indices; ///< none: the vertices as they follow each other
};

/// What a primitive is read with.
struct PrimitiveSource {
    const ModelReading& reading;
    Buffers& buffers;
    Accessors& accessors;
    std::vector<std::string>& warnings; ///< receives sentences
};

/// True where a primitive says where its vertices are.
bool hasPositions(const Json& primitive);

/// @param primitive       has positions
/// @param coordinate_set  the texture coordinates that its material uses
/// @return an error that names the file
Result<Primitive> findPrimitive(const PrimitiveSource& source, const Json& primitive,
                                std::uint64_t coordinate_set);

} // namespace quarn::gltf
