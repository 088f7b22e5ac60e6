#include "host/document/file/LightChoiceLayout.h"

#include "ground/Fields.h"
#include "ground/PathText.h"

#include <cmath>

namespace quarn {

namespace {

constexpr int LIGHT_LAYOUT_MAJOR = 1;
constexpr int LIGHT_LAYOUT_MINOR = 0;

/// A choice as it stands in the file.
struct LightFieldsOfFile {
    Surroundings surroundings = Surroundings::automatic;
    KM_wString picture;
    bool has_exposure = false;
    double exposure = 0.0;
    BackgroundKind background = BackgroundKind::automatic;
    KM_Color background_color;
    bool has_ground = true;
};

template <class Step, class AnyFields> bool choiceFields(Step step, AnyFields& fields) {
    return step(fields.surroundings, Surroundings::automatic, Surroundings::picture) &&
           step(fields.picture) && step(fields.has_exposure) && step(fields.exposure) &&
           step(fields.background, BackgroundKind::automatic, BackgroundKind::transparent) &&
           step(fields.background_color) && step(fields.has_ground) &&
           step.check(std::abs(fields.exposure) <= LightChoice::most_stops);
}

/// Of a newer minor layout, what follows is passed over.
bool endLayout(KM_BinaryArchive& archive, int minor) {
    std::span<const std::uint8_t> rest;
    return minor == LIGHT_LAYOUT_MINOR || archive.ViewBytes(archive.BytesLeft(), rest);
}

} // namespace

bool writeLightChoice(KM_BinaryArchive& archive, const LightChoice& choice) {
    const LightFieldsOfFile fields{choice.surroundings,
                                   textFromPath(choice.picture),
                                   choice.exposure.has_value(),
                                   choice.exposure.value_or(0.0),
                                   choice.background,
                                   choice.background_color,
                                   choice.has_ground};
    return archive.Write3dmChunkVersion(LIGHT_LAYOUT_MAJOR, LIGHT_LAYOUT_MINOR) &&
           choiceFields(FieldWriter(archive), fields);
}

bool readLightChoice(KM_BinaryArchive& archive, LightChoice& choice) {
    int major = 0;
    int minor = 0;
    LightFieldsOfFile fields;
    if (!archive.Read3dmChunkVersion(major, minor) || !choiceFields(FieldReader(archive), fields) ||
        !endLayout(archive, minor))
        return false;
    if (major != LIGHT_LAYOUT_MAJOR)
        return archive.Fail();
    choice.surroundings = fields.surroundings;
    choice.picture = pathFromText(fields.picture.View());
    if (fields.has_exposure)
        choice.exposure = fields.exposure;
    choice.background = fields.background;
    choice.background_color = fields.background_color;
    choice.has_ground = fields.has_ground;
    return true;
}

} // namespace quarn
