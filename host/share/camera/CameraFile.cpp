#include "host/share/camera/CameraFile.h"

#include "ground/PathText.h"

#include <fstream>
#include <string>
#include <utility>

namespace quarn {

namespace {

/// The mark stands behind little more than the version of the format and the program's.
constexpr std::size_t BYTES_TO_MARK = 512;

std::string startOf(const std::filesystem::path& file) {
    std::string bytes(BYTES_TO_MARK, '\0');
    std::ifstream stream(file, std::ios::binary);
    stream.read(bytes.data(), static_cast<std::streamsize>(bytes.size()));
    bytes.resize(static_cast<std::size_t>(stream.gcount()));
    return bytes;
}

} // namespace

std::optional<CameraForm> cameraFormOf(const std::filesystem::path& file) {
    constexpr std::pair<const wchar_t*, CameraForm> FORMS[] = {{L".gltf", CameraForm::gltf},
                                                               {L".glb", CameraForm::glb},
                                                               {L".json", CameraForm::json},
                                                               {L".csv", CameraForm::csv}};
    const KM_wString extension = textFromPath(file.extension());
    for (const auto& [ending, form] : FORMS)
        if (extension.CompareNoCase(ending) == 0)
            return form;
    return std::nullopt;
}

bool isOtherFile(const std::filesystem::path& file) {
    std::error_code error;
    if (!std::filesystem::is_regular_file(file, error))
        return false;
    const std::string start = startOf(file);
    return start.find(CAMERA_FILE_MARK) == std::string::npos &&
           !start.starts_with(CAMERA_TABLE_START);
}

} // namespace quarn
