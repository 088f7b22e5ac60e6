// What a document's scene is lit by, as it is handed to whoever draws it.
#include "host/document/DocumentDrawing.h"
#include "host/document/DocumentScene.h"
#include "import/ImportedModel.h"
#include "tests/host/document/DocumentFixtures.h"
#include "tests/import/environment/RadianceBytes.h"
#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>

#include <chrono>

namespace quarn::test {
namespace {

using testing::HasSubstr;
using testing::Not;

class DocumentLightTest : public DocumentTest {
protected:
    LightChoice& choice() { return document.renderWindow().settings.light; }
    LightSettings settings() { return document.drawing().light().settings(); }
    /// Chooses a picture of one pixel, which is as red as this.
    void choosePicture(std::uint8_t red) {
        writeFile(picture, flatRadiance(1, 1, {{red, 0, 0, ONE}}));
        choice().surroundings = Surroundings::picture;
        choice().picture = picture;
    }
    std::string printed() const { return KM_wString(front_end.printed()).ToUtf8(); }

    TempFolder folder;
    const std::filesystem::path picture = folder / "sky.hdr";
};

TEST_F(DocumentLightTest, ChoicesReachTheSceneThatIsDrawn) {
    choice().surroundings = Surroundings::studio;
    choice().exposure = 1.5;
    choice().background = BackgroundKind::color;
    choice().background_color = {1, 2, 3, 255};
    choice().has_ground = false;
    const auto scene = document.drawing().scene();
    ASSERT_TRUE(scene) << scene.message();
    const LightSettings& drawn = scene.value()->display().light();
    EXPECT_EQ(drawn.surroundings, Surroundings::studio);
    EXPECT_EQ(drawn.exposure, 1.5);
    EXPECT_EQ(drawn.background, BackgroundKind::color);
    EXPECT_EQ(drawn.background_color, (KM_Color{1, 2, 3, 255}));
    EXPECT_FALSE(drawn.has_ground);
    EXPECT_EQ(scene.value()->content().light, drawn);
}

TEST_F(DocumentLightTest, LengthsAreThoseOfTheDocumentsUnits) {
    EXPECT_EQ(settings().metres_per_unit, 1.0) << "without units";
    ImportedModel model;
    model.units = UnitSystem::millimeters;
    document.addModel(model);
    EXPECT_EQ(settings().metres_per_unit, 0.001);
}

TEST_F(DocumentLightTest, APictureIsReadOnceAndAgainWhenItsFileChanges) {
    choosePicture(128);
    const auto first = settings().picture;
    ASSERT_TRUE(first);
    EXPECT_EQ(first->rgb[0], 1.0F);
    EXPECT_EQ(settings().picture, first);
    choosePicture(64);
    std::filesystem::last_write_time(picture, std::filesystem::last_write_time(picture) +
                                                  std::chrono::seconds(2));
    ASSERT_TRUE(settings().picture);
    EXPECT_EQ(settings().picture->rgb[0], 0.5F);
    EXPECT_EQ(printed(), "");
}

TEST_F(DocumentLightTest, APictureThatIsMissingIsToldOnceAndTheLightIsTheAutomaticOne) {
    choosePicture(128);
    std::filesystem::remove(picture);
    EXPECT_EQ(settings().surroundings, Surroundings::sky);
    EXPECT_THAT(printed(), HasSubstr("Cannot read the picture " + picture.string()));
    EXPECT_THAT(printed(), HasSubstr("Until it can be read the light is the automatic one."));
    const std::string told = printed();
    EXPECT_FALSE(settings().picture);
    EXPECT_EQ(printed(), told);
    choosePicture(128);
    EXPECT_EQ(settings().surroundings, Surroundings::picture);
}

TEST_F(DocumentLightTest, ABrokenPictureIsToldAgainOnlyWhenItIsBrokenAnew) {
    choosePicture(128);
    writeFile(picture, "no picture");
    settings();
    const std::string told = printed();
    EXPECT_THAT(told, HasSubstr("it is no Radiance picture"));
    settings();
    EXPECT_EQ(printed(), told);
    writeFile(picture, "nor is this");
    settings();
    EXPECT_GT(printed().size(), told.size());
}

TEST_F(DocumentLightTest, PixelsThatAreTooBrightAreToldOnce) {
    choosePicture(128);
    writeFile(picture, flatRadiance(2, 1, {{255, 0, 0, 255}, {1, 1, 1, ONE}}));
    ASSERT_TRUE(settings().picture);
    settings();
    EXPECT_THAT(printed(), HasSubstr("sky.hdr"));
    EXPECT_THAT(printed(), HasSubstr("made black or as bright as that: 1."));
    EXPECT_EQ(printed().find("as bright as that"), printed().rfind("as bright as that"));
}

TEST_F(DocumentLightTest, APictureThatWasMovedWithItsDocumentIsFoundBesideIt) {
    choosePicture(128);
    const TempFolder elsewhere;
    document.setFile(elsewhere / "house.quarn");
    std::filesystem::rename(picture, elsewhere / "sky.hdr");
    ASSERT_TRUE(settings().picture);
    EXPECT_EQ(choice().picture, picture) << "the document keeps what was chosen";
    choosePicture(64);
    EXPECT_EQ(settings().picture->rgb[0], 0.5F) << "where it was chosen it is preferred";
}

TEST_F(DocumentLightTest, AProductStandsInAStudioWithoutTheSunAndABuildingUnderTheSkyWithIt) {
    addBox(document, {0, 0, 0}, {1, 1, 1});
    EXPECT_EQ(settings().surroundings, Surroundings::studio);
    EXPECT_TRUE(settings().first_light_is_sun);
    addBox(document, {0, 0, 0}, {1, 20, 1});
    EXPECT_EQ(settings().surroundings, Surroundings::sky);
    EXPECT_EQ(document.drawing().light().shiningLights().size(), 1U);
    choice().surroundings = Surroundings::studio;
    EXPECT_TRUE(settings().first_light_is_sun) << "it shines under the sky alone";
}

TEST_F(DocumentLightTest, WhatIsHiddenCountsSoThatTheLightStaysThroughoutAFilm) {
    addBox(document, {0, 0, 0}, {1, 20, 1});
    document.objects().setVisible(document.objects().objects()[0]->id, false);
    EXPECT_EQ(settings().surroundings, Surroundings::sky);
}

TEST_F(DocumentLightTest, WhoMovesTheSunHasTheSky) {
    addBox(document, {0, 0, 0}, {1, 1, 1});
    document.sun().beginChange();
    document.sun().setDirectionToSun({0, 0, 1});
    EXPECT_EQ(settings().surroundings, Surroundings::sky);
    EXPECT_EQ(document.drawing().light().shiningLights().size(), 1U);
    document.sun().setEnabled(false);
    EXPECT_EQ(settings().surroundings, Surroundings::studio);
}

KM_Light sunOfModel() {
    KM_Light sun;
    sun.SetStyle(KM_LightStyle::world_directional);
    sun.SetDirection({1, 0, -1});
    return sun;
}

TEST_F(DocumentLightTest, TheSunOfAModelShinesAloneWhereNobodyMovedThatOfTheDocument) {
    addBox(document, {0, 0, 0}, {1, 1, 1});
    DocumentLight& light = document.drawing().light();
    const int index = document.lights().add(sunOfModel());
    ASSERT_EQ(light.shiningLights().size(), 1U);
    EXPECT_EQ(light.shiningLights()[0].Direction(), KM_3dVector(1, 0, -1));
    EXPECT_EQ(settings().surroundings, Surroundings::sky);
    EXPECT_FALSE(settings().first_light_is_sun);
    document.lights().remove(index);
    ASSERT_EQ(light.shiningLights().size(), 1U);
    EXPECT_EQ(light.shiningLights()[0].Direction(), -document.sun().directionToSun());
    EXPECT_TRUE(settings().first_light_is_sun);
}

TEST_F(DocumentLightTest, ASunThatSomebodyMovedShinesBesideThatOfAModel) {
    document.lights().add(sunOfModel());
    document.sun().beginChange();
    document.sun().setDirectionToSun({0, 0, 1});
    EXPECT_EQ(document.drawing().light().shiningLights().size(), 2U);
    EXPECT_TRUE(settings().first_light_is_sun);
}

TEST_F(DocumentLightTest, ALampOfAModelLeavesTheSunOfTheDocumentOn) {
    KM_Light lamp = sunOfModel();
    lamp.SetStyle(KM_LightStyle::world_point);
    document.lights().add(lamp);
    EXPECT_EQ(document.drawing().light().shiningLights().size(), 2U);
}

TEST_F(DocumentLightTest, ASunStudyStandsUnderTheSkyUnlessAnotherLightIsChosen) {
    addBox(document, {0, 0, 0}, {1, 1, 1});
    SceneChanges study;
    study.sun.emplace();
    DocumentLight& light = document.drawing().light();
    EXPECT_EQ(light.settings().surroundings, Surroundings::studio);
    EXPECT_EQ(light.settings(study).surroundings, Surroundings::sky);
    choice().surroundings = Surroundings::studio;
    EXPECT_EQ(light.settings(study).surroundings, Surroundings::studio);
}

} // namespace
} // namespace quarn::test
