// The light among the render settings, at prompts.
#include "engine/images/Image.h"
#include "host/commands/ColorText.h"
#include "host/document/Document.h"
#include "host/document/DocumentDrawing.h"
#include "tests/host/app/TestCommand.h"
#include "tests/host/document/DocumentFixtures.h"
#include "tests/import/environment/RadianceBytes.h"
#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using testing::HasSubstr;

class LightSettingsTest : public HostTest {
protected:
    Document& document() { return Document::of(session.document()); }
    const LightChoice& light() { return document().renderWindow().settings.light; }
    CQuarnCommand::result set(const std::wstring& words) {
        return run((L"RenderSettings " + words + L" _Enter").c_str());
    }
    std::wstring pictureFile(const std::string& bytes) {
        writeFile(folder / "sky.hdr", bytes);
        return L"\"" + (folder / "sky.hdr").wstring() + L"\"";
    }

    TempFolder folder;
};

TEST_F(LightSettingsTest, EachPartIsChosenAndTheOthersStay) {
    ASSERT_EQ(set(L"Light Studio"), CQuarnCommand::success) << printed();
    EXPECT_EQ(light().surroundings, Surroundings::studio);
    ASSERT_EQ(set(L"Exposure 1.5 Background Colour #FF8800"), CQuarnCommand::success) << printed();
    EXPECT_EQ(light().surroundings, Surroundings::studio);
    EXPECT_EQ(light().exposure, 1.5);
    EXPECT_EQ(light().background, BackgroundKind::color);
    EXPECT_EQ(light().background_color, (KM_Color{255, 136, 0, 255}));
    ASSERT_EQ(set(L"Ground=No Background Transparent Light Sky"), CQuarnCommand::success);
    EXPECT_FALSE(light().has_ground);
    EXPECT_EQ(light().background, BackgroundKind::transparent);
    EXPECT_EQ(light().surroundings, Surroundings::sky);
    ASSERT_EQ(set(L"Light Automatic Exposure Automatic Background Automatic Ground=Yes"),
              CQuarnCommand::success);
    LightChoice fresh;
    fresh.background_color = {255, 136, 0, 255};
    EXPECT_EQ(light(), fresh);
}

TEST_F(LightSettingsTest, ThePromptShowsWhatIsChosen) {
    ASSERT_EQ(set(L"Light Sky Exposure -2 Background Colour black Ground=No"),
              CQuarnCommand::success);
    run(L"RenderSettings");
    ASSERT_FALSE(front_end.questions().empty());
    std::wstring shown;
    for (const auto& option : front_end.questions().back().options)
        shown += std::wstring(option.english_name.View()) + L"=" +
                 std::wstring(option.value.View()) + L" ";
    EXPECT_EQ(shown, L"Size=1280x720 Samples=64 PreviewSamples=4 Light=Sky Exposure=-2 "
                     L"Background=#000000 Ground=No ");
}

TEST_F(LightSettingsTest, WhatIsNotTakenChangesNothing) {
    const LightChoice before = light();
    for (const wchar_t* wrong :
         {L"Exposure 10.5", L"Exposure -11", L"Exposure bright", L"Light", L"Light Moon",
          L"Background Colour", L"Background Colour #ff88", L"Background Colour red",
          L"Background Colour #ff88001", L"Background Colour gg0000", L"Background White",
          L"Ground=Perhaps", L"Light Picture"}) {
        EXPECT_NE(set(wrong), CQuarnCommand::success) << KM_wString(wrong).ToUtf8();
        EXPECT_EQ(light(), before) << KM_wString(wrong).ToUtf8();
    }
    EXPECT_THAT(printed(), HasSubstr("\"red\" is no colour. Give one such as #ff8800, or black, "
                                     "grey or white."));
    EXPECT_EQ(set(L"Exposure 10 Exposure -10"), CQuarnCommand::success) << "the limits are taken";
    EXPECT_EQ(light().exposure, -10.0);
}

TEST_F(LightSettingsTest, APictureIsReadBeforeItIsTaken) {
    const std::wstring file = pictureFile(flatRadiance(1, 1, {{128, 0, 0, ONE}}));
    ASSERT_EQ(set(L"Light Picture " + file), CQuarnCommand::success) << printed();
    EXPECT_EQ(light().picture, folder / "sky.hdr");
    ASSERT_TRUE(document().drawing().light().settings().picture);
    EXPECT_EQ(document().drawing().light().settings().picture->rgb[0], 1.0F);
    ASSERT_EQ(set(L"Light Studio"), CQuarnCommand::success);
    const LightChoice before = light();
    EXPECT_EQ(set(L"Light Picture " + pictureFile("no picture")), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("sky.hdr: it is no Radiance picture"));
    std::filesystem::remove(folder / "sky.hdr");
    EXPECT_EQ(set(L"Light Picture " + file), CQuarnCommand::failure);
    EXPECT_EQ(light(), before);
}

TEST_F(LightSettingsTest, APathFromTheFolderOfTheProgramIsKeptAsAWholeOne) {
    pictureFile(flatRadiance(1, 1, {{128, 0, 0, ONE}}));
    const auto relative = std::filesystem::relative(folder / "sky.hdr");
    ASSERT_EQ(set(L"Light Picture \"" + relative.wstring() + L"\""), CQuarnCommand::success)
        << printed();
    EXPECT_TRUE(light().picture.is_absolute());
    EXPECT_TRUE(std::filesystem::equivalent(light().picture, folder / "sky.hdr"));
}

TEST_F(LightSettingsTest, PicturesWithoutOpacityAreRefusedWhereTheBackgroundIsTransparent) {
    ASSERT_EQ(run(L"RenderSettings Size 8 8 PreviewSamples 1 Background Transparent _Enter"),
              CQuarnCommand::success);
    RenderWindow& window = document().renderWindow();
    window.picture.resize(8, 8); // of no opacity
    const auto save = [this](const char* name) {
        return run((L"SaveRenderWindowAs \"" + (folder / name).wstring() + L"\"").c_str());
    };
    for (const char* name : {"a.jpg", "a.bmp"})
        EXPECT_EQ(save(name), CQuarnCommand::failure) << name;
    EXPECT_THAT(printed(),
                HasSubstr("Pictures of the kind bmp have no opacity, and the background is "
                          "transparent. Choose png, or another background with RenderSettings."));
    EXPECT_TRUE(std::filesystem::is_empty(folder.path()));
    EXPECT_EQ(save("a.png"), CQuarnCommand::success) << printed();
    EXPECT_EQ(save("a.tga"), CQuarnCommand::success) << printed();
    std::ranges::fill(window.picture.rgba, std::uint8_t{255});
    EXPECT_EQ(save("a.jpg"), CQuarnCommand::success) << "nothing of it is seen through";
}

TEST(ColorText, ColoursAreDigitsOrNames) {
    EXPECT_EQ(colorFromText(L"#ff8800"), (KM_Color{255, 136, 0, 255}));
    EXPECT_EQ(colorFromText(L"0000fF"), (KM_Color{0, 0, 255, 255}));
    EXPECT_EQ(colorFromText(L" White "), (KM_Color{255, 255, 255, 255}));
    EXPECT_EQ(colorFromText(L"grey"), colorFromText(L"808080"));
    for (const wchar_t* none :
         {L"", L"#", L"#fff", L"##ff8800", L"ff8800ff", L"0x8800", L"-12345", L"ff 800", L"blau"})
        EXPECT_FALSE(colorFromText(none)) << KM_wString(none).ToUtf8();
    EXPECT_EQ(colorText({1, 171, 0, 255}).View(), L"#01ab00");
}

} // namespace
} // namespace quarn::test
