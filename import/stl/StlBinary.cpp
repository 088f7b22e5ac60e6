#include "import/stl/StlBinary.h"

#include "import/ReadingProgress.h"
#include "import/assembly/MeshCleaning.h"
#include "import/files/ModelFileCheck.h"
#include "import/stl/StlMesh.h"
#include "import/text/LineCursor.h"
#include "kelmar/KM_LittleEndian.h"

#include <tbb/blocked_range.h>
#include <tbb/parallel_reduce.h>

#include <algorithm>
#include <bit>
#include <cstring>
#include <optional>

namespace quarn {

namespace {

constexpr std::size_t HEADER_BYTES = 80;
constexpr std::size_t FACETS_BEGIN = HEADER_BYTES + 4;
constexpr std::size_t FACET_BYTES = 50;
constexpr std::size_t NORMAL_BYTES = 12;
constexpr std::size_t PLACE_BYTES = 12;
constexpr std::uint16_t HIGHEST_BIT = 0x8000;

template <class Number> Number numberAt(const char* bytes) {
    return kelmar::fromLittleEndian<Number>(reinterpret_cast<const std::uint8_t*>(bytes));
}

float floatAt(const char* bytes) {
    return std::bit_cast<float>(numberAt<std::uint32_t>(bytes)) + 0.0F;
}

std::uint64_t claimedCount(std::string_view file) {
    return numberAt<std::uint32_t>(file.data() + HEADER_BYTES);
}

std::uint8_t byteOfFiveBits(unsigned bits) {
    return static_cast<std::uint8_t>(((bits & 31U) * 255U + 15U) / 31U);
}

/// The triangles of a file where they lie in it.
class BinaryFacets {
public:
    BinaryFacets(std::string_view file, std::size_t count, ReadingProgress& progress)
        : m_facets(file.data() + FACETS_BEGIN), m_progress(progress) {
        constexpr std::string_view MARK = "COLOR=";
        const std::size_t mark = file.substr(0, HEADER_BYTES - 4).find(MARK);
        if (mark != std::string_view::npos) {
            const char* const channels = file.data() + mark + MARK.size();
            m_color_of_all = {numberAt<std::uint8_t>(channels),
                              numberAt<std::uint8_t>(channels + 1),
                              numberAt<std::uint8_t>(channels + 2), 255};
        }
        m_has_colors = findColors(count);
    }

    std::optional<KM_Color> colorOfAll() const { return m_color_of_all; }

    KM_3fPoint corner(std::uint32_t number) const {
        if (number % PROGRESS_STEP == 0)
            m_progress.goesOn(PROGRESS_STEP);
        const char* const place = facet(number / 3) + NORMAL_BYTES + PLACE_BYTES * (number % 3);
        return {floatAt(place), floatAt(place + 4), floatAt(place + 8)};
    }

    bool hasColors() const { return m_has_colors; }

    KM_Color color(std::uint32_t number) const {
        const std::uint16_t bits = attributes(number);
        const std::uint8_t low = byteOfFiveBits(bits);
        const std::uint8_t middle = byteOfFiveBits(bits >> 5U);
        const std::uint8_t high = byteOfFiveBits(bits >> 10U);
        if (!hasOwnColor(bits))
            return m_color_of_all.value_or(KM_Color{255, 255, 255, 255});
        return m_color_of_all ? KM_Color{low, middle, high, 255} : KM_Color{high, middle, low, 255};
    }

private:
    static constexpr std::uint32_t PROGRESS_STEP = 1U << 20U;

    const char* facet(std::size_t number) const { return m_facets + FACET_BYTES * number; }

    std::uint16_t attributes(std::size_t number) const {
        return numberAt<std::uint16_t>(facet(number) + NORMAL_BYTES + 3 * PLACE_BYTES);
    }

    bool hasOwnColor(std::uint16_t bits) const {
        const bool is_highest_set = (bits & HIGHEST_BIT) != 0;
        return m_color_of_all ? !is_highest_set && bits != 0 : is_highest_set;
    }

    bool findColors(std::size_t count) const {
        using Range = tbb::blocked_range<std::size_t>;
        return tbb::parallel_reduce(
            Range(0, count, 16384), false,
            [this](const Range& range, bool found) {
                for (std::size_t i = range.begin(); i != range.end() && !found; ++i)
                    found = hasOwnColor(attributes(i));
                return found;
            },
            [](bool a, bool b) { return a || b; });
    }

    const char* m_facets;
    ReadingProgress& m_progress;
    std::optional<KM_Color> m_color_of_all;
    bool m_has_colors = false;
};

/// How many triangles the file holds, with a word on a count that says otherwise.
Result<std::size_t> countFacets(std::string_view file, std::vector<std::string>& warnings) {
    if (file.size() < FACETS_BEGIN)
        return Error{"the file is cut short"};
    const std::uint64_t claimed = claimedCount(file);
    const std::uint64_t held = (file.size() - FACETS_BEGIN) / FACET_BYTES;
    const std::string counts = std::to_string(claimed) + " triangles but holds";
    if (claimed > held)
        return Error{"it claims " + counts + " only " + std::to_string(held)};
    const std::uint64_t read = claimed == 0 ? held : claimed; // some never fill in their count
    if (claimed < held)
        warnings.push_back("It claims " + counts + " " + std::to_string(held) + "; " +
                           std::to_string(read) + " were read.");
    return static_cast<std::size_t>(read);
}

std::shared_ptr<const Material> materialOf(KM_Color color) {
    Material material;
    material.base_color = color;
    return std::make_shared<const Material>(std::move(material));
}

} // namespace

bool hasBinaryStlLength(std::string_view file) {
    return file.size() >= FACETS_BEGIN &&
           file.size() - FACETS_BEGIN == FACET_BYTES * claimedCount(file);
}

Result<SourceScene> readBinaryStl(const ModelReading& reading) {
    constexpr std::string_view REPAIR = "Export the model again or restore the file.";
    constexpr std::uint64_t MOST_BYTES_OF_FACET = sizeof(KM_MeshTriangle) + 3 * sizeof(KM_3fPoint);
    const std::string_view file = textOf(reading.bytes);
    SourceScene scene;
    const Result<std::size_t> count = countFacets(file, scene.warnings);
    if (!count)
        return cannotReadModel(reading.path, count.message(), REPAIR);
    const std::uint64_t most_bytes = count.value() * MOST_BYTES_OF_FACET;
    const Result<void> taken = reading.budget.take(most_bytes, "triangles");
    if (!taken)
        return cannotReadModel(reading.path, taken.message(), "Use a smaller model.");
    ReadingProgress progress(reading.watch, ReadingStep::read, 6 * count.value());
    const BinaryFacets facets(file, count.value(), progress);
    SourceMesh piece;
    piece.mesh = StlMesh(facets, count.value()).make();
    if (!progress.goesOn(0))
        return cannotReadModel(reading.path, "it was given up", "Read it again.");
    reading.budget.giveBack(3 * sizeof(KM_3fPoint) * count.value() -
                            sizeof(KM_3fPoint) * piece.mesh->m_V.size());
    const std::size_t dropped = dropUnusableTriangles(*piece.mesh);
    if (dropped > 0) {
        dropUnusedVertices(*piece.mesh);
        scene.warnings.push_back(leftOutText(dropped, count.value(), "triangles"));
    }
    if (facets.colorOfAll() && !facets.hasColors())
        piece.material = materialOf(*facets.colorOfAll());
    scene.meshes.push_back(std::move(piece));
    scene.places.push_back({});
    return scene;
}

} // namespace quarn
