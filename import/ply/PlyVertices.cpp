#include "import/ply/PlyVertices.h"

#include "engine/scene/PlacedMesh.h"
#include "import/assembly/Extent.h"
#include "import/assembly/MeshPlacing.h"
#include "import/assembly/StoredColor.h"
#include "import/ply/PlyNumbers.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>
#include <mutex>

namespace quarn {

namespace {

/// The numbers of a vertex that mean something here.
enum Slot : std::uint8_t { x, y, z, nx, ny, nz, s, t, red, green, blue, alpha, none };
constexpr std::size_t SLOTS = none + 1;

constexpr std::pair<std::string_view, Slot> SLOT_NAMES[] = {
    {"x", x},
    {"y", y},
    {"z", z},
    {"nx", nx},
    {"ny", ny},
    {"nz", nz},
    {"normal_x", nx},
    {"normal_y", ny},
    {"normal_z", nz},
    {"s", s},
    {"t", t},
    {"u", s},
    {"v", t},
    {"texture_u", s},
    {"texture_v", t},
    {"texture_s", s},
    {"texture_t", t},
    {"red", red},
    {"green", green},
    {"blue", blue},
    {"alpha", alpha},
    {"r", red},
    {"g", green},
    {"b", blue},
    {"a", alpha},
    {"diffuse_red", red},
    {"diffuse_green", green},
    {"diffuse_blue", blue},
    {"diffuse_alpha", alpha},
};

struct Column {
    Slot slot = none;
    PlyProperty property;
};

/// Which number of a vertex goes where.
class Columns {
public:
    explicit Columns(const PlyElement& element) {
        for (const PlyProperty& property : element.properties) {
            Column column{none, property};
            for (const auto& [name, slot] : SLOT_NAMES)
                if (name == property.name && !property.isList() && !m_has[slot])
                    column.slot = slot;
            m_has[column.slot] = true;
            m_types[column.slot] = property.type;
            m_columns.push_back(std::move(column));
        }
    }

    const std::vector<Column>& all() const { return m_columns; }
    bool has(Slot slot) const { return m_has[slot]; }
    PlyType type(Slot slot) const { return m_types[slot]; }
    bool hasPlaces() const { return has(x) || has(y) || has(z); }
    bool hasNormals() const { return has(nx) && has(ny) && has(nz); }
    bool hasTexture() const { return has(s) && has(t); }
    bool hasColors() const { return has(red) && has(green) && has(blue); }

private:
    std::vector<Column> m_columns;
    std::array<bool, SLOTS> m_has{};
    std::array<PlyType, SLOTS> m_types{};
};

using Numbers = std::array<double, SLOTS>;

float finiteOrZero(double number) {
    return isUsableCoordinate(number) ? static_cast<float>(number) + 0.0F : 0.0F;
}

KM_3fVector unitNormal(double a, double b, double c) {
    const double length = std::sqrt(a * a + b * b + c * c);
    if (!(length > 0.0) || !std::isfinite(length))
        return {};
    return {static_cast<float>(a / length + 0.0), static_cast<float>(b / length + 0.0),
            static_cast<float>(c / length + 0.0)};
}

/// Fractions are shares of the full colour, and so are whole numbers of 16 bits of theirs; others
/// are bytes, however wide they are stored.
std::uint8_t colorByte(double number, PlyType type) {
    const bool is_share = type >= PlyType::float32;
    const bool is_wide = type == PlyType::int16 || type == PlyType::uint16;
    const double full = is_share ? 1.0 : is_wide ? 65535.0 : 255.0;
    return byteFromUnit(static_cast<float>(number / full));
}

class VertexReading {
public:
    VertexReading(PlyContents& contents, std::size_t kind)
        : m_contents(contents), m_kind(kind), m_element(contents.header().elements[kind]),
          m_columns(m_element) {}

    PlyVertices read() {
        if (!prepare())
            return {};
        readAll();
        const KM_3dPoint origin = keepsDigits() ? nearbyOrigin(m_box) : KM_3dPoint::Origin;
        if (m_contents.why().empty() && origin != KM_3dPoint::Origin) {
            m_vertices.origin = origin;
            readAll();
        }
        return std::move(m_vertices);
    }

private:
    bool prepare() {
        if (!m_columns.hasPlaces()) {
            m_contents.fail("its vertices have no coordinates");
            return false;
        }
        if (m_element.count > std::uint64_t{std::numeric_limits<int>::max()}) {
            m_contents.fail("it has more than two billion vertices");
            return false;
        }
        const std::uint64_t bytes = sizeof(KM_3fPoint) +
                                    (m_columns.hasNormals() ? sizeof(KM_3fVector) : 0) +
                                    (m_columns.hasTexture() ? sizeof(KM_2fPoint) : 0) +
                                    (m_columns.hasColors() ? sizeof(KM_Color) : 0);
        const Result<void> taken = m_contents.budget().take(m_element.count * bytes, "vertices");
        if (!taken) {
            m_contents.fail(taken.message());
            return false;
        }
        makeRoom();
        return true;
    }

    void makeRoom() {
        const auto count = static_cast<std::size_t>(m_element.count);
        KM_Mesh& mesh = m_vertices.mesh;
        mesh.m_V.reserve(count + 1); // see PadForRayTracing
        mesh.m_V.resize(count);
        mesh.m_N.resize(m_columns.hasNormals() ? count : 0);
        mesh.m_T.resize(m_columns.hasTexture() ? count : 0);
        mesh.m_C.resize(m_columns.hasColors() ? count : 0);
    }

    /// Whether the file may hold more digits than single precision keeps.
    bool keepsDigits() const {
        const bool has_doubles = std::ranges::any_of(std::array{x, y, z}, [this](Slot slot) {
            return m_columns.has(slot) && m_columns.type(slot) != PlyType::float32;
        });
        return has_doubles || m_contents.header().format == PlyFormat::text;
    }

    void readAll() {
        m_vertices.unusable = 0;
        m_contents.readParts(m_kind, [this](const PlyPart& part, std::size_t) {
            if (m_contents.header().format == PlyFormat::text)
                readPart(part, PlyTextNumbers(part.bytes, m_contents.header()));
            else
                readPart(part, PlyBinaryNumbers(part.bytes, m_contents.header()));
            m_contents.finish(part);
        });
    }

    template <class Source> void readPart(const PlyPart& part, Source source) {
        Extent extent;
        std::uint64_t unusable = 0;
        Numbers numbers{};
        numbers[alpha] = m_columns.type(alpha) >= PlyType::float32 ? 1.0 : 255.0;
        for (std::uint64_t i = 0; i < part.count; ++i) {
            if (!source.begin())
                return m_contents.fail(part, part.first + i, part.bytes.data(), "is missing");
            if (!readNumbers(part, part.first + i, source, numbers))
                return;
            const bool is_usable = put(static_cast<std::size_t>(part.first + i), numbers);
            unusable += is_usable ? 0 : 1;
            if (is_usable)
                extent.add({numbers[x], numbers[y], numbers[z]});
        }
        const std::lock_guard lock(m_gathering);
        m_box.Union(extent.box());
        m_vertices.unusable += unusable;
    }

    template <class Source>
    bool readNumbers(const PlyPart& part, std::uint64_t element, Source& source, Numbers& numbers) {
        std::size_t taken = 0;
        for (const Column& column : m_columns.all()) {
            PlyTaken what = PlyTaken::yes;
            if (column.property.isList())
                what = skipList(source, column.property);
            else if (column.slot == none)
                what = source.skip(column.property.type);
            else
                what = source.take(column.property.type, numbers[column.slot]);
            if (what != PlyTaken::yes) {
                m_contents.fail(part, element, source.place(),
                                whyNot(what, source.badWord(), taken));
                return false;
            }
            ++taken;
        }
        return true;
    }

    /// Exporters that leave out a face element of no faces state its list behind the vertices'
    /// numbers, and write none there.
    template <class Source> PlyTaken skipList(Source& source, const PlyProperty& list) {
        if (source.isAtEnd())
            return PlyTaken::yes;
        std::int64_t count = 0;
        PlyTaken what = source.takeWhole(*list.count_type, count);
        for (; what == PlyTaken::yes && count > 0; --count)
            what = source.skip(list.type);
        return what;
    }

    std::string whyNot(PlyTaken what, std::string_view bad_word, std::size_t taken) const {
        if (what == PlyTaken::bad)
            return "holds " + quotedWord(bad_word) + " where a number belongs";
        return "holds " + std::to_string(taken) + " of the " +
               std::to_string(m_columns.all().size()) + " numbers of a '" + m_element.name +
               "'; all must stand on one line";
    }

    bool put(std::size_t vertex, const Numbers& numbers) {
        KM_Mesh& mesh = m_vertices.mesh;
        const KM_3dPoint& origin = m_vertices.origin;
        if (m_columns.hasNormals())
            mesh.m_N[vertex] = unitNormal(numbers[nx], numbers[ny], numbers[nz]);
        if (m_columns.hasTexture())
            mesh.m_T[vertex] = {finiteOrZero(numbers[s]), finiteOrZero(numbers[t])};
        if (m_columns.hasColors())
            mesh.m_C[vertex] = {colorByte(numbers[red], m_columns.type(red)),
                                colorByte(numbers[green], m_columns.type(green)),
                                colorByte(numbers[blue], m_columns.type(blue)),
                                colorByte(numbers[alpha], m_columns.type(alpha))};
        const KM_3dPoint p(numbers[x] - origin.x, numbers[y] - origin.y, numbers[z] - origin.z);
        const bool is_usable =
            isUsableCoordinate(p.x) && isUsableCoordinate(p.y) && isUsableCoordinate(p.z);
        constexpr float NO_NUMBER = std::numeric_limits<float>::quiet_NaN();
        mesh.m_V[vertex] =
            is_usable ? KM_3fPoint(static_cast<float>(p.x) + 0.0F, static_cast<float>(p.y) + 0.0F,
                                   static_cast<float>(p.z) + 0.0F)
                      : KM_3fPoint(NO_NUMBER, NO_NUMBER, NO_NUMBER);
        return is_usable;
    }

    PlyContents& m_contents;
    std::size_t m_kind;
    const PlyElement& m_element;
    Columns m_columns;
    PlyVertices m_vertices;
    std::mutex m_gathering; ///< of the box and the count of unusable ones
    KM_BoundingBox m_box;
};

} // namespace

PlyVertices readPlyVertices(PlyContents& contents, std::size_t kind) {
    return VertexReading(contents, kind).read();
}

} // namespace quarn
