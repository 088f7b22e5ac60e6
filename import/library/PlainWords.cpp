#include "import/library/PlainWords.h"

#include <algorithm>
#include <charconv>
#include <cstdint>

namespace quarn {
namespace {

/// One line without the full stop at its end.
std::string cleaned(std::string_view text) {
    constexpr std::size_t longest = 300;
    std::string clean(text.substr(0, longest));
    std::replace_if(
        clean.begin(), clean.end(), [](char c) { return static_cast<unsigned char>(c) < 32; }, ' ');
    while (!clean.empty() && (clean.back() == ' ' || clean.back() == '.')) {
        clean.pop_back();
    }
    return clean.empty() ? "its contents cannot be understood" : clean;
}

bool contains(std::string_view text, std::string_view part) {
    return text.find(part) != std::string_view::npos;
}

/// From "aiMesh::mFaces[7]::mIndices[2] is out of range"; faces are counted from 0 there.
std::string outOfRange(std::string_view error) {
    constexpr std::string_view before = "mFaces[";
    const std::size_t at = error.find(before);
    std::uint64_t face = 0;
    if (at != std::string_view::npos) {
        const std::string_view digits = error.substr(at + before.size());
        std::from_chars(digits.data(), digits.data() + digits.size(), face);
    }
    return "an index of its face number " + std::to_string(face + 1) + " is out of range";
}

/// From "Mesh "roof" has no faces".
std::string withoutFaces(std::string_view error) {
    const std::size_t begin = error.find('"');
    const std::size_t end = error.rfind('"');
    const std::string name =
        begin < end ? "'" + cleaned(error.substr(begin + 1, end - begin - 1)) + "' " : "";
    return "its mesh " + name + "has no faces, or none whose indices are in range";
}

} // namespace

std::string inPlainWords(std::string_view error) {
    if (contains(error, "mIndices[") && contains(error, "out of range")) {
        return outOfRange(error);
    }
    if (contains(error, "has no faces")) {
        return withoutFaces(error);
    }
    if (contains(error, "bad_alloc")) {
        return "there is not enough memory for what it claims to hold";
    }
    if (contains(error, "No suitable reader found")) {
        return "its contents are not what its name says, or of a version that is not known";
    }
    return cleaned(error);
}

} // namespace quarn
