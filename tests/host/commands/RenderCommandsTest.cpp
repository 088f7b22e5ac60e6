#include "engine/images/Image.h"
#include "host/document/Document.h"
#include "sdk/qncore/QnPlatform.h"
#include "tests/host/app/TestCommand.h"
#include "tests/host/document/DocumentFixtures.h"
#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using testing::HasSubstr;

class RenderCommandsTest : public HostTest {
protected:
    void SetUp() override {
        addBox(document(), {-5, -5, 0}, {5, 5, 5});
        ASSERT_EQ(run(L"RenderSettings Size 24 16 Samples 4 PreviewSamples 2 _Enter"),
                  CQuarnCommand::success);
    }
    Document& document() { return Document::of(session.document()); }
    RenderWindow& window() { return document().renderWindow(); }
    CQuarnCommand::result save(const std::filesystem::path& to) {
        return run(
            (KM_wString(L"SaveRenderWindowAs \"") + KM_wString::FromUtf8(to.string()) + L"\"")
                .Array());
    }

    TempFolder folder;
};

TEST_F(RenderCommandsTest, RenderFillsTheWindowAtTheRenderSize) {
    EXPECT_FALSE(window().isOpen());
    ASSERT_EQ(run(L"_Render"), CQuarnCommand::success) << printed();
    EXPECT_EQ(window().picture.width, 24);
    EXPECT_EQ(window().picture.height, 16);
    const auto full = window().picture.rgba;
    ASSERT_EQ(run(L"_RenderPreview"), CQuarnCommand::success);
    EXPECT_FALSE(window().picture.rgba == full) << "of fewer samples";
    ASSERT_EQ(run(L"_Render"), CQuarnCommand::success);
    EXPECT_TRUE(window().picture.rgba == full) << "the same every time";
}

TEST_F(RenderCommandsTest, WindowIsSavedAndClosed) {
    ASSERT_EQ(run(L"_Render"), CQuarnCommand::success);
    ASSERT_EQ(save(folder.path() / "a picture.bmp"), CQuarnCommand::success) << printed();
    EXPECT_EQ(std::filesystem::file_size(folder.path() / "a picture.bmp"), 54U + 16U * 72U);
    EXPECT_EQ(run(L"_CloseRenderWindow"), CQuarnCommand::success);
    EXPECT_FALSE(window().isOpen());
    EXPECT_EQ(run(L"_CloseRenderWindow"), CQuarnCommand::success) << "closed already";
    EXPECT_EQ(save(folder.path() / "b.bmp"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("There is no rendered picture. Make one with Render"));
    EXPECT_FALSE(std::filesystem::exists(folder.path() / "b.bmp"));
}

TEST_F(RenderCommandsTest, SavingTellsWhatIsWrongWithTheFile) {
    ASSERT_EQ(run(L"_Render"), CQuarnCommand::success);
    EXPECT_EQ(save(folder.path() / "a.gif"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("pictures of the kind '.gif' are not known"));
    EXPECT_EQ(save(folder.path() / "missing" / "a.png"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("a.png"));
    EXPECT_TRUE(std::filesystem::is_empty(folder.path()));
    EXPECT_TRUE(window().isOpen());
}

TEST_F(RenderCommandsTest, AWriteProtectedPictureIsNotReplaced) {
    ASSERT_EQ(run(L"_Render"), CQuarnCommand::success);
    writeFile(folder / "a.png", "old");
    std::filesystem::permissions(folder / "a.png", std::filesystem::perms::owner_read);
    EXPECT_EQ(save(folder / "a.png"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("a.png': it is write-protected"));
    EXPECT_EQ(readFile(folder / "a.png"), "old");
}

TEST_F(RenderCommandsTest, ANameWithBlanksWithoutQuotesIsToldAndNothingIsWritten) {
    ASSERT_EQ(run(L"_Render"), CQuarnCommand::success);
    const std::wstring name = (folder / "my").wstring() + L".png house.png";
    EXPECT_EQ(run((L"_-SaveRenderWindowAs " + name).c_str()), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("Nothing was written: behind the name of the file stands "
                                     "\"house.png\"."));
    EXPECT_TRUE(std::filesystem::is_empty(folder.path()));
}

TEST_F(RenderCommandsTest, EscapeCancelsAndKeepsTheEarlierPicture) {
    ASSERT_EQ(run(L"_RenderPreview"), CQuarnCommand::success);
    const auto earlier = window().picture.rgba;
    front_end.setKeyDown(VK_ESCAPE, true);
    EXPECT_EQ(run(L"_Render"), CQuarnCommand::cancel);
    EXPECT_EQ(run(L"_RenderPreview"), CQuarnCommand::cancel);
    EXPECT_TRUE(window().picture.rgba == earlier);
    front_end.setKeyDown(VK_ESCAPE, false);
    EXPECT_EQ(run(L"_Render"), CQuarnCommand::success);
    front_end.interrupt();
    EXPECT_EQ(run(L"_Render"), CQuarnCommand::cancel);
}

TEST_F(RenderCommandsTest, SettingsAreKeptUntilTheyAreConfirmed) {
    const RenderSettings before = window().settings;
    EXPECT_EQ(run(L"RenderSettings Size 100 50"), CQuarnCommand::cancel) << "without _Enter";
    EXPECT_EQ(run(L"RenderSettings Samples 0 _Enter"), CQuarnCommand::cancel);
    EXPECT_EQ(run(L"RenderSettings Samples 16385 _Enter"), CQuarnCommand::cancel);
    EXPECT_EQ(run(L"RenderSettings Size 0 10 _Enter"), CQuarnCommand::cancel);
    EXPECT_EQ(run(L"RenderSettings Quality _Enter"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("\"Quality\" is no option here"));
    EXPECT_TRUE(window().settings == before);
    EXPECT_EQ(run(L"RenderSettings _Enter"), CQuarnCommand::success);
    EXPECT_TRUE(window().settings == before);
    EXPECT_EQ(run(L"RenderSettings Size 100 50 PreviewSamples 16384 _Enter"),
              CQuarnCommand::success);
    EXPECT_EQ(window().settings.width_px, 100);
    EXPECT_EQ(window().settings.height_px, 50);
    EXPECT_EQ(window().settings.samples, before.samples);
    EXPECT_EQ(window().settings.preview_samples, 16384);
}

TEST_F(RenderCommandsTest, SettingsTakeTheirLimitsAndNothingBeyond) {
    const auto set = [this](const std::wstring& settings) {
        return run((L"RenderSettings " + settings + L" _Enter").c_str());
    };
    const RenderSettings before = window().settings;
    for (const wchar_t* beyond :
         {L"Size 0 10", L"Size 10 0", L"Size -1 10", L"Size 16385 10", L"Size 10 16385",
          L"Size 10.5 10", L"Size ten ten", L"Samples 0", L"Samples -1", L"Samples 16385",
          L"Samples 1.5", L"PreviewSamples 0", L"PreviewSamples 16385"}) {
        EXPECT_EQ(set(beyond), CQuarnCommand::cancel) << KM_wString(beyond).ToUtf8();
        EXPECT_TRUE(window().settings == before) << KM_wString(beyond).ToUtf8();
    }
    EXPECT_EQ(set(L"Size 16384 16384 Samples 16384 PreviewSamples 16384"), CQuarnCommand::success);
    EXPECT_EQ(window().settings.height_px, 16384);
    EXPECT_EQ(set(L"Size 1 1 Samples 1 PreviewSamples 1"), CQuarnCommand::success);
    ASSERT_EQ(run(L"_Render"), CQuarnCommand::success) << printed();
    EXPECT_EQ(window().picture.rgba.size(), 4U);
}

TEST_F(RenderCommandsTest, ClosingAWindowThatNeverOpenedSucceeds) {
    ASSERT_FALSE(window().isOpen());
    EXPECT_EQ(run(L"_CloseRenderWindow"), CQuarnCommand::success);
}

TEST_F(RenderCommandsTest, AFolderThatTakesNoFilesIsToldAndTheWindowStaysOpen) {
    ASSERT_EQ(run(L"_RenderPreview"), CQuarnCommand::success);
    EXPECT_EQ(save("/proc/self/a.png"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("Cannot write '/proc/self/a.png'"));
    EXPECT_TRUE(window().isOpen());
    // What could not be saved there can be saved elsewhere, and a new one can be rendered.
    EXPECT_EQ(save(folder.path() / "a.png"), CQuarnCommand::success) << printed();
    EXPECT_EQ(save("/proc/self/a.png"), CQuarnCommand::failure);
    EXPECT_EQ(run(L"_RenderPreview"), CQuarnCommand::success) << printed();
}

TEST_F(RenderCommandsTest, EmptyDocumentIsRendered) {
    ASSERT_EQ(run(L"New"), CQuarnCommand::success);
    EXPECT_EQ(window().settings.width_px, 1280) << "settings are the document's";
    ASSERT_EQ(run(L"RenderSettings Size 8 8 _Enter"), CQuarnCommand::success);
    EXPECT_EQ(run(L"_RenderPreview"), CQuarnCommand::success) << printed();
    EXPECT_TRUE(window().isOpen());
}

} // namespace
} // namespace quarn::test
