#pragma once

#include <array>
#include <charconv>
#include <cmath>
#include <cstddef>
#include <map>
#include <ostream>
#include <span>
#include <string>
#include <utility>
#include <vector>

/// A place or a direction; metres, x east, y north, z up.
struct Vec {
    double x = 0.0;
    double y = 0.0;
    double z = 0.0;
};

inline Vec operator+(const Vec& a, const Vec& b) {
    return {a.x + b.x, a.y + b.y, a.z + b.z};
}
inline Vec operator-(const Vec& a, const Vec& b) {
    return {a.x - b.x, a.y - b.y, a.z - b.z};
}
inline Vec operator*(const Vec& a, double s) {
    return {a.x * s, a.y * s, a.z * s};
}
inline Vec cross(const Vec& a, const Vec& b) {
    return {a.y * b.z - a.z * b.y, a.z * b.x - a.x * b.z, a.x * b.y - a.y * b.x};
}
inline double length(const Vec& a) {
    return std::sqrt(a.x * a.x + a.y * a.y + a.z * a.z);
}
inline Vec unit(const Vec& a) {
    const double l = length(a);
    return l > 0.0 ? a * (1.0 / l) : Vec{0.0, 0.0, 1.0};
}

/// A corner of a face: its place and the direction that its surface faces there.
struct Corner {
    Vec place;
    Vec normal;
};

/// Collects named objects made of faces and polylines, and writes them as OBJ. Numbers have four
/// decimals, a tenth of a millimetre, and equal ones are stored once.
class ModelWriter {
public:
    /// Faces that follow belong to this object, which may have been begun before, and have this
    /// material of the MTL file.
    void beginObject(const std::string& name, const std::string& material) {
        const auto [found, is_new] = m_object_index.emplace(name, m_objects.size());
        if (is_new) {
            m_objects.push_back("o " + name + "\nusemtl " + material + "\n");
        }
        m_current = found->second;
    }

    /// A flat face with corners anticlockwise as seen from outside.
    void face(std::span<const Vec> places) {
        const Vec normal = normalOf(places);
        std::vector<Corner> corners;
        for (const Vec& place : places) {
            corners.push_back({place, normal});
        }
        face(std::span<const Corner>(corners));
    }
    void face(std::initializer_list<Vec> places) {
        face(std::span<const Vec>(places.begin(), places.size()));
    }

    /// A part of a curved surface: each corner has a normal of its own.
    void face(std::span<const Corner> corners) {
        std::string& body = m_objects[m_current];
        body += 'f';
        for (const Corner& corner : corners) {
            body += ' ' + std::to_string(indexOf(m_places, "v", corner.place)) + "//" +
                    std::to_string(indexOf(m_normals, "vn", unit(corner.normal)));
        }
        body += '\n';
    }

    void polyline(const std::string& name, std::span<const Vec> places) {
        std::string body = "o " + name + "\nl";
        for (const Vec& place : places) {
            body += ' ' + std::to_string(indexOf(m_places, "v", place));
        }
        m_objects.push_back(body + '\n');
    }

    void write(std::ostream& file, const std::string& material_file) const {
        file << "mtllib " << material_file << '\n' << m_vertices;
        for (const std::string& object : m_objects) {
            file << object;
        }
    }

private:
    using Index = std::map<std::string, std::size_t>;

    static Vec normalOf(std::span<const Vec> places) {
        Vec sum;
        for (std::size_t i = 1; i + 1 < places.size(); ++i) {
            sum = sum + cross(places[i] - places[0], places[i + 1] - places[0]);
        }
        return unit(sum);
    }

    static std::string number(double value) {
        std::array<char, 32> text{};
        const double rounded = std::round(value * 1e4) / 1e4 + 0.0; // no negative zero
        const auto end = std::to_chars(text.data(), text.data() + text.size(), rounded,
                                       std::chars_format::fixed, 4);
        return {text.data(), end.ptr};
    }

    std::size_t indexOf(Index& index, const char* keyword, const Vec& v) {
        const std::string text = number(v.x) + ' ' + number(v.y) + ' ' + number(v.z);
        const auto [found, is_new] = index.emplace(text, index.size() + 1);
        if (is_new) {
            m_vertices += std::string(keyword) + ' ' + text + '\n';
        }
        return found->second;
    }

    std::string m_vertices;
    std::vector<std::string> m_objects;
    std::size_t m_current = 0; ///< object that faces go to
    Index m_object_index;
    Index m_places;
    Index m_normals;
};
