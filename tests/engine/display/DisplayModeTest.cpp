#include "engine/display/DisplayMode.h"

#include <gtest/gtest.h>

#include <set>
#include <string>
#include <vector>

namespace quarn {
namespace {

TEST(DisplayMode, StandardModesStandInTheHostsOrder) {
    std::vector<std::string> names;
    for (const DisplayModeAttributes& mode : standardDisplayModes())
        names.push_back(KM_wString(mode.english_name).ToUtf8());
    EXPECT_EQ(names, (std::vector<std::string>{"Wireframe", "Shaded", "Rendered", "Translucent",
                                               "X-Ray", "Drawing", "Clay"}));
}

TEST(DisplayMode, EveryModeHasAnIdOfItsOwnByWhichItIsFound) {
    std::set<KM_UUID> ids;
    for (const DisplayModeAttributes& mode : standardDisplayModes()) {
        EXPECT_FALSE(KM_UuidIsNil(mode.id));
        EXPECT_TRUE(ids.insert(mode.id).second);
        EXPECT_EQ(findDisplayMode(mode.id), &mode);
    }
    EXPECT_EQ(findDisplayMode(KM_nil_uuid), nullptr);
    EXPECT_EQ(findDisplayMode(rendered_mode_id)->english_name, L"Rendered");
    EXPECT_EQ(findDisplayMode(wireframe_mode_id)->english_name, L"Wireframe");
    EXPECT_EQ(findDisplayMode(shaded_mode_id)->english_name, L"Shaded");
}

TEST(DisplayMode, OnlyWireframeIsOfTheWireframeKind) {
    for (const DisplayModeAttributes& mode : standardDisplayModes())
        EXPECT_EQ(mode.kind == DisplayKind::wireframe, mode.english_name == L"Wireframe");
}

TEST(DisplayMode, RenderedAndClayUseTheDocumentsLightsWithShadows) {
    for (const DisplayModeAttributes& mode : standardDisplayModes()) {
        const bool lit = mode.english_name == L"Rendered" || mode.english_name == L"Clay";
        EXPECT_EQ(mode.uses_document_lights, lit);
        EXPECT_EQ(mode.casts_shadows, lit);
    }
}

} // namespace
} // namespace quarn
