#pragma once

#include <cstdint>
#include <filesystem>
#include <map>
#include <optional>
#include <string>
#include <vector>

namespace quarn {

/// How many faces (triangles, line segments or points) a glTF file says that a mesh has.
struct GltfFaces {
    std::uint64_t all = 0;    ///< of all meshes that have the name
    std::uint64_t fewest = 0; ///< of one of them
    unsigned meshes = 0;      ///< that have the name
};

/// What the text part of a glTF file (version 2.0) says, and the reading library does not hand on.
struct GltfDescription {
    /// By the names that the reading library gives: that of the mesh, or "meshes[<index>]" where it
    /// has none; with "-<index>" behind it for each part of a mesh of several parts ("primitives").
    std::map<std::string, GltfFaces> faces;
    std::vector<std::string> required_extensions; ///< without which the file cannot be understood
};

/// Reads what a .gltf or .glb file says of itself. The vertices and the pictures that may stand in
/// the text are stepped over.
/// @return nothing where the text cannot be understood, or is of another version
std::optional<GltfDescription> readGltfDescription(const std::filesystem::path& path);

} // namespace quarn
