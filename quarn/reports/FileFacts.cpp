#include "quarn/reports/FileFacts.h"

#include <cmath>

namespace quarn::program {

std::string formatName(const std::filesystem::path& model) {
    std::string extension = model.extension().native();
    if (extension.empty())
        return "unknown";
    extension.erase(0, 1);
    for (char& c : extension)
        c = c >= 'a' && c <= 'z' ? static_cast<char>(c - 32) : c;
    return extension;
}

double millisecondsOf(std::chrono::steady_clock::duration time) {
    return std::round(std::chrono::duration<double, std::milli>(time).count());
}

} // namespace quarn::program
