#include "import/files/ModelFileCheck.h"

#include <array>
#include <cerrno>
#include <cstdint>
#include <cstring>
#include <fstream>

namespace quarn {
namespace {

namespace fs = std::filesystem;

constexpr std::uintmax_t largest_model_bytes = 4ULL << 30;
constexpr std::string_view choose_model = "Choose a model file (OBJ, glTF, GLB, PLY, STL, ...).";

} // namespace

Error cannotReadModel(const fs::path& path, std::string_view why, std::string_view advice) {
    return {"Cannot read '" + path.string() + "': " + std::string(why) + ". " +
            std::string(advice)};
}

std::string modelFormat(const fs::path& path) {
    std::string extension = path.extension().string();
    for (char& c : extension) {
        c = c >= 'A' && c <= 'Z' ? static_cast<char>(c + 32) : c;
    }
    return extension.empty() ? extension : extension.substr(1);
}

Result<void> checkModelFile(const fs::path& path) {
    std::error_code failure;
    const fs::file_status status = fs::status(path, failure);
    if (!fs::exists(status)) {
        return cannotReadModel(path, "there is no such file", "Check the name and the folder.");
    }
    if (fs::is_directory(status)) {
        return cannotReadModel(path, "it is a folder", choose_model);
    }
    if (!fs::is_regular_file(status)) {
        return cannotReadModel(path, "it is not an ordinary file", choose_model);
    }
    const std::uintmax_t size = fs::file_size(path, failure);
    if (!failure && size == 0) {
        return cannotReadModel(path, "the file is empty", choose_model);
    }
    if (!failure && size > largest_model_bytes) {
        return cannotReadModel(path, "it is larger than 4 GB", "Split the model into parts.");
    }
    std::ifstream file(path, std::ios::binary);
    if (failure || !file) {
        return cannotReadModel(path,
                               std::string("it cannot be opened (") + std::strerror(errno) + ")",
                               "Check its permissions.");
    }
    return {};
}

} // namespace quarn
