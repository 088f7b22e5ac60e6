#pragma once

#include <cstdint>

namespace quarn::chunk {

/// The id of a chunk whose first four bytes spell a name.
constexpr std::uint32_t named(const char (&name)[5]) {
    std::uint32_t id = 0;
    for (int i = 3; i >= 0; --i)
        id = id << 8 | static_cast<unsigned char>(name[i]);
    return id;
}

inline constexpr std::uint32_t SETTINGS = named("DOCU");
inline constexpr std::uint32_t TEXTURE = named("TEXR");
inline constexpr std::uint32_t MATERIAL = named("MATL");
/// What the material directly before it is beyond its base colour.
inline constexpr std::uint32_t SURFACE = named("SURF");
inline constexpr std::uint32_t MESH = named("MESH");
inline constexpr std::uint32_t OBJECT = named("OBJT");
inline constexpr std::uint32_t VIEW = named("VIEW");
inline constexpr std::uint32_t CAMERA = named("CAMR");
inline constexpr std::uint32_t EDGES = named("EDGE");
inline constexpr std::uint32_t RENDERING = named("RNDR");
/// What a scene is lit by beside its lights, and what it stands before and on.
inline constexpr std::uint32_t SURROUNDINGS = named("SURR");
/// What the place of the sun study is called, and its clocks.
inline constexpr std::uint32_t STUDIED_PLACE = named("PLCE");
inline constexpr std::uint32_t LIGHT = named("LITE");
inline constexpr std::uint32_t PLUG_IN = named("PLUG");
/// The last one: a file without it was cut off.
inline constexpr std::uint32_t END = named("DEND");

} // namespace quarn::chunk
