#pragma once

#include "import/assembly/MeshPlacing.h"
#include "import/assembly/PolygonTriangles.h"
#include "import/ply/PlyFaceRole.h"
#include "import/ply/PlyFaces.h"
#include "import/ply/PlyNumbers.h"

#include <algorithm>
#include <cstdint>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace quarn {

/// Reads one part of an element.
template <class Source> class PlyFacePart {
public:
    /// @param room  for triangles; those that find none go to `faces`
    PlyFacePart(PlyContents& contents, const PlyPart& part, const std::vector<KM_3fPoint>& vertices,
                std::span<KM_MeshTriangle> room, PlyFaces& faces)
        : m_contents(contents), m_part(part), m_element(contents.header().elements[part.kind]),
          m_vertices(vertices), m_source(part.bytes, contents.header()), m_room(room),
          m_faces(faces), m_is_strip(m_element.name == "tristrips") {
        for (const PlyProperty& property : m_element.properties)
            m_roles.push_back(plyFaceRole(m_element, property));
    }

    /// @return how many triangles are in their room
    std::size_t read() {
        for (std::uint64_t i = 0; i < m_part.count; ++i) {
            m_why = "is missing";
            if (!m_source.begin() || !readOne()) {
                m_contents.fail(m_part, m_part.first + i, m_source.place(), m_why);
                break;
            }
            addOne();
        }
        return m_filled;
    }

private:
    using Role = PlyFaceRole;

    /// Where in a strip a new one begins.
    static constexpr std::int64_t RESTART = -1;

    static bool isWholeNumber(std::string_view word) {
        if (word.starts_with('-') || word.starts_with('+'))
            word.remove_prefix(1);
        return !word.empty() && word.find_first_not_of("0123456789") == std::string_view::npos;
    }

    bool readOne() {
        m_why.clear();
        m_corners.clear();
        m_texture.clear();
        m_taken = 0;
        for (std::size_t i = 0; i < m_roles.size(); ++i) {
            const PlyProperty& property = m_element.properties[i];
            if (!(property.isList() ? readList(property, m_roles[i])
                                    : readNumber(property, m_roles[i])))
                return false;
            ++m_taken;
        }
        return true;
    }

    bool readNumber(const PlyProperty& property, Role role) {
        if (role != Role::nothing) {
            std::int64_t index = 0;
            return takeIndex(property, index) ||
                   (m_why.empty() && fail("holds " + std::to_string(m_taken) + ofNumbers()));
        }
        return m_source.skip(property.type) == PlyTaken::yes ||
               fail("holds " + std::to_string(m_taken) + ofNumbers());
    }

    bool readList(const PlyProperty& property, Role role) {
        std::int64_t count = 0;
        const PlyTaken what = m_source.takeWhole(*property.count_type, count);
        if (what == PlyTaken::ended)
            return fail("ends where the number of corners belongs");
        if (what == PlyTaken::bad || count < 0)
            return fail("holds " +
                        quotedWord(what == PlyTaken::bad ? std::string(m_source.badWord())
                                                         : std::to_string(count)) +
                        " where the number of corners belongs");
        for (std::int64_t i = 0; i < count; ++i)
            if (!readOfList(property, role))
                return !m_why.empty() ? false
                                      : fail("ends after " + std::to_string(i) + " of " +
                                             std::to_string(count) + " corners");
        return true;
    }

    /// @return false, with no reason given, where there is nothing to read
    bool readOfList(const PlyProperty& property, Role role) {
        if (role == Role::nothing)
            return m_source.skip(property.type) == PlyTaken::yes;
        if (role == Role::indices) {
            std::int64_t index = 0;
            return takeIndex(property, index);
        }
        double number = 0.0;
        const PlyTaken what = m_source.take(property.type, number);
        if (what == PlyTaken::bad)
            return fail("holds " + quotedWord(m_source.badWord()) + " where a number belongs");
        m_texture.push_back(isUsableCoordinate(number) ? static_cast<float>(number) + 0.0F : 0.0F);
        return what == PlyTaken::yes;
    }

    bool takeIndex(const PlyProperty& property, std::int64_t& index) {
        const PlyTaken what = m_source.takeWhole(property.type, index);
        if (what == PlyTaken::ended)
            return false;
        if (what == PlyTaken::bad)
            return fail(isWholeNumber(m_source.badWord())
                            ? outOfRange(m_source.badWord().substr(0, 40))
                            : "holds " + quotedWord(m_source.badWord()) +
                                  ", which is no index of a vertex");
        const bool is_vertex = index >= 0 && std::cmp_less(index, m_vertices.size());
        if (!is_vertex && !(m_is_strip && index == RESTART))
            return fail(outOfRange(std::to_string(index)));
        m_corners.push_back(static_cast<std::uint32_t>(index));
        return true;
    }

    std::string outOfRange(std::string_view index) const {
        return "holds the index " + std::string(index) + ", which is out of range: there are " +
               std::to_string(m_vertices.size()) + " vertices";
    }

    std::string ofNumbers() const {
        return " of the " + std::to_string(m_element.properties.size()) + " numbers of a '" +
               m_element.name + "'; all must stand on one line";
    }

    bool fail(std::string why) {
        m_why = std::move(why);
        return false;
    }

    void addOne() {
        if (m_is_strip)
            return addStrip();
        if (m_corners.size() >= 3)
            addPolygon();
        else if (m_corners.size() == 2)
            m_faces.lines.push_back({m_corners[0], m_corners[1]});
        else if (m_corners.size() == 1)
            m_faces.points.push_back(m_corners[0]);
        else
            ++m_faces.without_corners;
    }

    void addPolygon() {
        if (m_corners.size() == 3)
            return addTriangle(0, 1, 2);
        m_places.clear();
        for (const std::uint32_t corner : m_corners)
            m_places.push_back(m_vertices[corner].ToDouble());
        for (const auto& [a, b, c] : m_polygon.cut(m_places))
            addTriangle(a, b, c);
    }

    /// @param a, b, c  corners of the face
    void addTriangle(std::uint32_t a, std::uint32_t b, std::uint32_t c) {
        push({{m_corners[a], m_corners[b], m_corners[c]}});
        if (std::ranges::find(m_roles, Role::texture) == m_roles.end())
            return;
        for (const std::uint32_t corner : {a, b, c}) {
            const std::size_t at = 2 * std::size_t{corner};
            m_faces.texture.push_back(at + 1 < m_texture.size()
                                          ? KM_2fPoint{m_texture[at], m_texture[at + 1]}
                                          : KM_2fPoint{});
        }
    }

    /// Every other triangle of a strip turns the other way; those of no area only lead on.
    void addStrip() {
        std::size_t begin = 0;
        for (std::size_t i = 0; i < m_corners.size(); ++i) {
            if (m_corners[i] == static_cast<std::uint32_t>(RESTART)) {
                begin = i + 1;
                continue;
            }
            if (i < begin + 2)
                continue;
            const std::uint32_t a = m_corners[i - 2];
            const std::uint32_t b = m_corners[i - 1];
            const std::uint32_t c = m_corners[i];
            if (a == b || b == c || c == a)
                continue;
            const bool is_even = (i - begin) % 2 == 0;
            push({{is_even ? a : b, is_even ? b : a, c}});
        }
    }

    void push(const KM_MeshTriangle& triangle) {
        if (m_filled < m_room.size())
            m_room[m_filled++] = triangle;
        else
            m_faces.triangles.push_back(triangle);
    }

    PlyContents& m_contents;
    const PlyPart& m_part;
    const PlyElement& m_element;
    const std::vector<KM_3fPoint>& m_vertices;
    Source m_source;
    std::span<KM_MeshTriangle> m_room;
    std::size_t m_filled = 0;
    PlyFaces& m_faces;
    bool m_is_strip;
    std::vector<Role> m_roles; ///< of the properties
    std::string m_why;
    std::size_t m_taken = 0;              ///< properties of the element in hand
    std::vector<std::uint32_t> m_corners; ///< of the element in hand
    std::vector<float> m_texture;         ///< likewise, two for each corner
    std::vector<KM_3dPoint> m_places;
    PolygonTriangles m_polygon;
};

} // namespace quarn
