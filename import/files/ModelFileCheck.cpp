#include "import/files/ModelFileCheck.h"

#include <cerrno>
#include <cstdint>
#include <cstring>
#include <fstream>
#include <sstream>

namespace quarn {
namespace {

namespace fs = std::filesystem;

constexpr std::uintmax_t largest_model_bytes = 4ULL << 30;
constexpr std::string_view choose_model = "Choose a model file (OBJ, glTF, GLB, PLY, STL, ...).";
constexpr std::string_view export_again = "Export the model again or restore the file.";

/// Why the bytes of a file cannot be what its extension says; empty when nothing speaks against it.
/// The counts stand at the first line that is neither the keyword nor a comment.
std::string whyBadOff(std::istream& file, std::uint64_t size) {
    constexpr int most_lines = 1000;
    constexpr std::uint64_t least_bytes_a_line = 6; // three numbers
    std::string line;
    for (int i = 0; i < most_lines && std::getline(file, line); ++i) {
        const std::size_t digits = line.find_first_of("0123456789");
        const std::size_t letters = line.find_first_not_of("OFFCNST4n \t\r0123456789");
        if (digits == std::string::npos || letters != std::string::npos) {
            continue;
        }
        std::uint64_t vertices = 0;
        std::uint64_t faces = 0;
        std::istringstream(line.substr(digits)) >> vertices >> faces;
        const std::uint64_t most = size / least_bytes_a_line + 1;
        return vertices <= most && faces <= most ? std::string()
                                                 : "it claims more vertices or faces than it holds";
    }
    return {};
}

std::string whyBadBytes(const fs::path& path, std::istream& file, std::uint64_t size) {
    const std::string format = modelFormat(path);
    return format == "off" ? whyBadOff(file, size) : std::string();
}

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
    const std::string why = whyBadBytes(path, file, size);
    return why.empty() ? Result<void>() : cannotReadModel(path, why, export_again);
}

} // namespace quarn
