#include "host/document/file/StudiedPlaceLayout.h"

#include "ground/Fields.h"

#include <cmath>

namespace quarn {

namespace {

constexpr int PLACE_LAYOUT_MAJOR = 1;
constexpr int PLACE_LAYOUT_MINOR = 0;

template <class Step, class Place> bool placeFields(Step step, Place& place) {
    return step(place.city) && step(place.zone) && step(place.latitude_deg) &&
           step(place.longitude_deg) &&
           step.check(std::abs(place.latitude_deg) <= 90.0 && place.longitude_deg >= -180.0 &&
                      place.longitude_deg <= 360.0);
}

} // namespace

bool writeStudiedPlace(KM_BinaryArchive& archive, const StudiedPlace& place) {
    return archive.Write3dmChunkVersion(PLACE_LAYOUT_MAJOR, PLACE_LAYOUT_MINOR) &&
           placeFields(FieldWriter(archive), place);
}

bool readStudiedPlace(KM_BinaryArchive& archive, StudiedPlace& place) {
    int major = 0;
    int minor = 0;
    if (!archive.Read3dmChunkVersion(major, minor) || !placeFields(FieldReader(archive), place))
        return false;
    std::span<const std::uint8_t> rest;
    if (minor != PLACE_LAYOUT_MINOR && !archive.ViewBytes(archive.BytesLeft(), rest))
        return false;
    return major == PLACE_LAYOUT_MAJOR || archive.Fail();
}

} // namespace quarn
