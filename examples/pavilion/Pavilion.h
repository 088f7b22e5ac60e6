#pragma once

#include "examples/pavilion/Figures.h"
#include "examples/pavilion/Garden.h"
#include "examples/pavilion/Houses.h"
#include "examples/pavilion/Temple.h"
#include "examples/pavilion/Walk.h"

#include <filesystem>
#include <fstream>

/// The whole example model: a small pavilion on a town square.
namespace pavilion {

struct Paint {
    const char* name;
    const char* rgb; ///< sRGB, 0 to 1
};

inline constexpr Paint paints[] = {
    {"stone_light", "0.90 0.86 0.77"},   {"stone_warm", "0.88 0.81 0.68"},
    {"stone_dark", "0.58 0.53 0.46"},    {"paving_light", "0.80 0.75 0.66"},
    {"paving_warm", "0.74 0.64 0.52"},   {"paving_dark", "0.60 0.52 0.44"},
    {"terracotta", "0.75 0.39 0.26"},    {"terracotta_dark", "0.60 0.30 0.21"},
    {"copper", "0.42 0.66 0.58"},        {"brass", "0.80 0.64 0.30"},
    {"wood", "0.55 0.37 0.23"},          {"wood_dark", "0.33 0.22 0.15"},
    {"plaster_cream", "0.93 0.88 0.76"}, {"plaster_ochre", "0.90 0.73 0.46"},
    {"plaster_rose", "0.86 0.62 0.53"},  {"plaster_blue", "0.64 0.73 0.78"},
    {"shutter_green", "0.27 0.43 0.36"}, {"shutter_blue", "0.30 0.42 0.55"},
    {"white", "0.93 0.92 0.89"},         {"glass", "0.20 0.27 0.34"},
    {"water", "0.25 0.52 0.60"},         {"grass", "0.46 0.58 0.29"},
    {"hedge", "0.29 0.42 0.22"},         {"cypress", "0.22 0.36 0.23"},
    {"leaves", "0.38 0.53 0.24"},        {"leaves_deep", "0.31 0.46 0.23"},
    {"leaves_light", "0.48 0.61 0.28"},  {"bark", "0.40 0.30 0.22"},
    {"iron", "0.17 0.18 0.20"},          {"lamp", "0.99 0.93 0.74"},
    {"mortar", "0.66 0.60 0.52"},        {"skin", "0.83 0.66 0.55"},
    {"cloth_dark", "0.24 0.25 0.29"},    {"coat_red", "0.66 0.25 0.22"},
    {"coat_blue", "0.25 0.38 0.55"},     {"coat_ochre", "0.85 0.67 0.35"}};

inline bool writeMaterials(const std::filesystem::path& path) {
    std::ofstream file(path, std::ios::binary);
    for (const Paint& paint : paints) {
        file << "newmtl " << paint.name << "\nKd " << paint.rgb << "\n\n";
    }
    file.close();
    return file.good();
}

inline bool writeModel(const std::filesystem::path& path) {
    ModelWriter model;
    garden::add(model);
    temple::add(model);
    houses::add(model);
    figures::add(model);
    model.polyline("Walk", walk::points());
    std::ofstream file(path, std::ios::binary);
    model.write(file, "pavilion.mtl");
    file.close();
    return file.good();
}

/// Writes pavilion.obj and pavilion.mtl into a folder, which must exist.
/// @return false when a file could not be written whole
inline bool write(const std::filesystem::path& folder) {
    return writeMaterials(folder / "pavilion.mtl") && writeModel(folder / "pavilion.obj");
}

} // namespace pavilion
