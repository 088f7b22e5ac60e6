#pragma once

#include <filesystem>
#include <optional>

namespace quarn {

enum class CameraForm { gltf, glb, json, csv };

/// What tells a camera file near its beginning, in every form but that of a table.
inline constexpr const char* CAMERA_FILE_MARK = "quarn-camera";
/// What a table of cameras begins with.
inline constexpr const char* CAMERA_TABLE_START = "name,frame,time_s,units,projection,place_x,";

/// By the extension, ignoring case; nothing for one that stands for none.
std::optional<CameraForm> cameraFormOf(const std::filesystem::path& file);

/// Whether a file is there that is no camera file of this program: a model of the same name, say,
/// which may not be lost.
bool isOtherFile(const std::filesystem::path& file);

} // namespace quarn
