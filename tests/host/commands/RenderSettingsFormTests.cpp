// The light among the render settings, in their form.
#include "host/commands/RenderSettingsForm.h"
#include "tests/host/commands/HostFormFixture.h"
#include "tests/import/environment/RadianceBytes.h"
#include "tests/support/TempFolder.h"

namespace quarn::test {
namespace {

using Settings = RenderSettingsForm;

class RenderSettingsFormTest : public FormTest {
protected:
    LightChoice& light() { return document().renderWindow().settings.light; }
    std::wstring pictureFile(const std::string& bytes) {
        writeFile(folder / "sky.hdr", bytes);
        return (folder / "sky.hdr").wstring();
    }

    TempFolder folder;
};

TEST_F(RenderSettingsFormTest, ShowsTheLightAndTakesItUnchanged) {
    light().surroundings = Surroundings::sky;
    light().exposure = -0.5;
    light().background = BackgroundKind::color;
    light().background_color = {255, 136, 0, 255};
    light().has_ground = false;
    const LightChoice before = light();
    const auto ended = answer(L"_RenderSettings", [](HeadlessDialogWindow& form) {
        EXPECT_EQ(form.pickedEntry(Settings::light_id), static_cast<int>(Surroundings::sky));
        EXPECT_EQ(form.text(Settings::exposure_id), L"-0.5");
        EXPECT_EQ(form.pickedEntry(Settings::background_id),
                  static_cast<int>(BackgroundKind::color));
        EXPECT_EQ(form.text(Settings::color_id), L"#ff8800");
        EXPECT_EQ(form.pickedEntry(Settings::ground_id), static_cast<int>(Settings::off));
        form.pressOk();
    });
    EXPECT_EQ(ended, CQuarnCommand::success);
    EXPECT_EQ(light(), before);
}

TEST_F(RenderSettingsFormTest, TakesWhatIsChosen) {
    const std::wstring file = pictureFile(flatRadiance(1, 1, {{128, 0, 0, ONE}}));
    answer(L"_RenderSettings", [&](HeadlessDialogWindow& form) {
        EXPECT_EQ(form.text(Settings::exposure_id), L"");
        form.pick(Settings::light_id, static_cast<int>(Surroundings::picture));
        form.type(Settings::picture_id, file);
        form.type(Settings::exposure_id, L"1,5");
        form.pick(Settings::background_id, static_cast<int>(BackgroundKind::transparent));
        form.pick(Settings::ground_id, Settings::off);
        form.pressOk();
    });
    EXPECT_EQ(light().surroundings, Surroundings::picture);
    EXPECT_EQ(light().picture, folder / "sky.hdr");
    EXPECT_EQ(light().exposure, 1.5);
    EXPECT_EQ(light().background, BackgroundKind::transparent);
    EXPECT_FALSE(light().has_ground);
    answer(L"_RenderSettings", [](HeadlessDialogWindow& form) {
        form.type(Settings::exposure_id, L" ");
        form.pressOk();
    });
    EXPECT_FALSE(light().exposure) << "an empty field is automatic";
}

TEST_F(RenderSettingsFormTest, RefusesWhatIsNoExposureAndNoColour) {
    for (const wchar_t* text : {L"10.5", L"-11"})
        EXPECT_EQ(refusal(L"_RenderSettings", Settings::exposure_id, text),
                  L"Enter a number between -10 and 10");
    light().background = BackgroundKind::color;
    EXPECT_EQ(refusal(L"_RenderSettings", Settings::color_id, L"blau"),
              L"\"blau\" is no colour. Give one such as #ff8800, or black, grey or white.");
    light().background = BackgroundKind::automatic;
    answer(L"_RenderSettings", [](HeadlessDialogWindow& form) {
        form.type(Settings::color_id, L"blau");
        form.pressOk();
        EXPECT_FALSE(form.isOpen()) << "it does not count";
    });
}

TEST_F(RenderSettingsFormTest, APictureThatCannotBeReadKeepsTheFormOpen) {
    light().surroundings = Surroundings::picture;
    light().picture = pictureFile("no picture");
    EXPECT_THAT(KM_wString(refusal(L"_RenderSettings", Settings::picture_id,
                                   (folder / "sky.hdr").wstring()))
                    .ToUtf8(),
                testing::HasSubstr("sky.hdr: it is no Radiance picture"));
}

TEST_F(RenderSettingsFormTest, AChosenPictureIsFilledInAndItsLightSelected) {
    const std::wstring file = pictureFile(flatRadiance(1, 1, {{128, 0, 0, ONE}}));
    front_end.addFileChoice({FileChoice::Kind::chosen, file});
    answer(L"_RenderSettings", [&](HeadlessDialogWindow& form) {
        EXPECT_TRUE(form.click(Settings::choose_picture_id));
        EXPECT_EQ(form.text(Settings::picture_id), file);
        form.pressOk();
    });
    EXPECT_EQ(light().surroundings, Surroundings::picture);
    EXPECT_EQ(light().picture, folder / "sky.hdr");
}

} // namespace
} // namespace quarn::test
