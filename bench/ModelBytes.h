// The same rolling landscape as a file of each format.
#pragma once

#include <array>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <string>

namespace bench {

inline constexpr int million_squares = 707;       // a side: 2 * 707 * 707 = 999 698 triangles
inline constexpr int five_million_squares = 1581; // likewise 4 999 122

/// A rolling landscape over a square grid.
inline std::array<float, 3> vertexAt(int i, int j) {
    return {0.1F * static_cast<float>(i), 0.1F * static_cast<float>(j),
            std::sin(0.05F * static_cast<float>(i)) * std::cos(0.04F * static_cast<float>(j))};
}

/// Calls `take` with the three vertex numbers, from 0, of each triangle.
template <class Take> void forEachTriangle(int squares, Take take) {
    const std::int32_t side = squares + 1;
    for (int j = 0; j < squares; ++j) {
        for (int i = 0; i < squares; ++i) {
            const std::int32_t a = j * side + i;
            take(a, a + 1, a + side + 1);
            take(a, a + side + 1, a + side);
        }
    }
}

inline std::string plyBytes(int squares) {
    std::string bytes = "ply\nformat binary_little_endian 1.0\nelement vertex " +
                        std::to_string((squares + 1) * (squares + 1)) +
                        "\nproperty float x\nproperty float y\nproperty float z\nelement face " +
                        std::to_string(2 * squares * squares) +
                        "\nproperty list uchar int vertex_indices\nend_header\n";
    for (int j = 0; j <= squares; ++j) {
        for (int i = 0; i <= squares; ++i) {
            const auto vertex = vertexAt(i, j);
            bytes.append(reinterpret_cast<const char*>(vertex.data()), sizeof vertex);
        }
    }
    forEachTriangle(squares, [&bytes](std::int32_t a, std::int32_t b, std::int32_t c) {
        const std::array<std::int32_t, 3> corners{a, b, c};
        bytes += '\3';
        bytes.append(reinterpret_cast<const char*>(corners.data()), sizeof corners);
    });
    return bytes;
}

inline std::string bytesOfNumber(std::size_t number) {
    const auto value = static_cast<std::uint32_t>(number);
    return {reinterpret_cast<const char*>(&value), sizeof value};
}

inline std::string glbBytes(int squares) {
    std::string binary;
    for (int j = 0; j <= squares; ++j) {
        for (int i = 0; i <= squares; ++i) {
            const auto vertex = vertexAt(i, j);
            binary.append(reinterpret_cast<const char*>(vertex.data()), sizeof vertex);
        }
    }
    const std::string places = std::to_string(binary.size());
    forEachTriangle(squares, [&binary](std::int32_t a, std::int32_t b, std::int32_t c) {
        const std::array<std::int32_t, 3> corners{a, b, c};
        binary.append(reinterpret_cast<const char*>(corners.data()), sizeof corners);
    });
    const std::string all = std::to_string(binary.size());
    std::string text =
        R"({"asset":{"version":"2.0"},"nodes":[{"mesh":0}],"meshes":[{"primitives":[{"indices":1,)"
        R"("attributes":{"POSITION":0}}]}],"accessors":[{"bufferView":0,"componentType":5126,)"
        R"("type":"VEC3","count":)" +
        std::to_string((squares + 1) * (squares + 1)) +
        R"(},{"bufferView":0,"componentType":5125,"type":"SCALAR","byteOffset":)" + places +
        R"(,"count":)" + std::to_string(6 * squares * squares) +
        R"(}],"bufferViews":[{"buffer":0,"byteLength":)" + all + R"(}],"buffers":[{"byteLength":)" +
        all + "}]}";
    text.resize((text.size() + 3) / 4 * 4, ' ');
    return "glTF" + bytesOfNumber(2) + bytesOfNumber(28 + text.size() + binary.size()) +
           bytesOfNumber(text.size()) + "JSON" + text + bytesOfNumber(binary.size()) +
           std::string("BIN\0", 4) + binary;
}

inline void appendNumber(std::string& text, float value) {
    std::array<char, 32> digits{};
    const auto end = std::to_chars(digits.data(), digits.data() + digits.size(), value,
                                   std::chars_format::fixed, 6);
    text.append(1, ' ').append(digits.data(), end.ptr);
}

inline std::string objBytes(int squares) {
    std::string text;
    for (int j = 0; j <= squares; ++j) {
        for (int i = 0; i <= squares; ++i) {
            text += 'v';
            for (const float number : vertexAt(i, j)) {
                appendNumber(text, number);
            }
            text += '\n';
        }
    }
    forEachTriangle(squares, [&text](std::int32_t a, std::int32_t b, std::int32_t c) {
        text += "f " + std::to_string(a + 1) + ' ' + std::to_string(b + 1) + ' ' +
                std::to_string(c + 1) + '\n';
    });
    return text;
}

inline std::string stlBytes(int squares) {
    std::string bytes(80, ' ');
    const auto count = static_cast<std::uint32_t>(2 * squares * squares);
    bytes.append(reinterpret_cast<const char*>(&count), sizeof count);
    forEachTriangle(squares, [&](std::int32_t a, std::int32_t b, std::int32_t c) {
        std::array<float, 12> facet{}; // a normal that is not given, then the corners
        int next = 3;
        for (const std::int32_t corner : {a, b, c}) {
            for (const float number : vertexAt(corner % (squares + 1), corner / (squares + 1)))
                facet[static_cast<std::size_t>(next++)] = number;
        }
        bytes.append(reinterpret_cast<const char*>(facet.data()), sizeof facet);
        bytes.append(2, '\0');
    });
    return bytes;
}

} // namespace bench
