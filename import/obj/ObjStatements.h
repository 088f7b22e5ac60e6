#pragma once

#include "import/obj/ObjPart.h"

#include <string>
#include <string_view>

namespace quarn {

/// Reads the statements of an OBJ file one after the other into a part.
class ObjStatements {
public:
    explicit ObjStatements(ObjPart& part);

    /// @param statement  one line, or several that backslashes join
    /// @param place      where it begins in the file's text
    /// @param is_cut     the file ends with it, without a line break
    void read(std::string_view statement, const char* place, bool is_cut);

private:
    struct Corner {
        std::uint32_t place = OBJ_NO_INDEX;
        std::uint32_t texture = OBJ_NO_INDEX;
        std::uint32_t normal = OBJ_NO_INDEX;
        int slashes = 0;
    };

    void readVertexPart(std::string_view line);
    void readOther(std::string_view line);
    void readPlace(std::string_view rest);
    void readColor(const std::array<double, 7>& numbers, int count);
    void readTexture(std::string_view rest);
    void readNormal(std::string_view rest);
    void readFace(std::string_view rest);
    void readLine(std::string_view rest);
    void readPoints(std::string_view rest);
    bool readCorners(std::string_view rest, std::string_view element);
    bool readCorner(std::string_view& rest, Corner& corner);
    bool takeIndex(std::string_view& rest, std::size_t known, std::uint32_t& index);
    void addFace();
    void addPolyline();
    void change(ObjChange::Kind kind, std::string_view name);
    ObjSection& sectionInHand() { return m_part.sections.back(); }
    void fault(std::string why);
    void tellUnread(std::string_view rest);

    ObjPart& m_part;
    std::vector<Corner> m_corners; ///< of the element in hand
    const char* m_place = nullptr; ///< of the statement in hand
    bool m_is_cut = false;
};

} // namespace quarn
