#include "host/session/StatedSite.h"

#include "ground/FileBytes.h"
#include "import/files/ModelFileCheck.h"
#include "import/ifc/IfcPlace.h"

namespace quarn {

std::optional<StatedSite> statedSite(const std::filesystem::path& model) {
    constexpr std::size_t MOST_BYTES = std::size_t{2} << 30;
    if (modelFormat(model) != "ifc")
        return std::nullopt;
    const auto bytes = readFileBytes(model, MOST_BYTES);
    const auto place = bytes ? placeOfIfc(bytes.value().bytes()) : std::nullopt;
    if (!place)
        return std::nullopt;
    return StatedSite{place->latitude_deg, place->longitude_deg, place->north_angle_deg};
}

} // namespace quarn
