#include "host/recording/FramesManifest.h"

#include "kelmar/KM_Viewport.h"
#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::HasSubstr;

FramesManifest sampleManifest() {
    FramesManifest manifest;
    manifest.program = "quarn 1.0.0";
    manifest.name = "Haus \"Süd\" <b>";
    manifest.kind = "one_day_sun";
    manifest.frames = 3;
    manifest.width_px = 64;
    manifest.height_px = 48;
    manifest.mode = "Rendered";
    manifest.extension = "jpg";
    manifest.frame_rate = 10;
    manifest.metres_per_unit = 0.3048;
    manifest.place = "Zürich, Switzerland";
    manifest.document = "00000000000000ab";
    manifest.settings = "00000000000000cd";
    ManifestFrame first{0, manifest.name + "000.jpg", 1234, 0xFFFF'FFFF'FFFF'FFFEU, {}, {}};
    first.camera = FrameCamera{{1.5, -2.25, 1e-300}, {0.1, 0.2, 0.3}, {0.0, 0.0, 1.0}, false, 50.0};
    first.sun = FrameSun{"2026-06-21T14:30:00", "UTC+1", 187.25, 61.5};
    ManifestFrame third{2, manifest.name + "002.jpg", 99, 7, {}, {}};
    third.camera = FrameCamera{{}, {}, {0.0, 1.0, 0.0}, true, 0.0, 12.5, 8.25};
    manifest.images = {first, third};
    return manifest;
}

std::string messageFor(const std::string& text) {
    const auto parsed = parseFramesManifest(text, "walk.frames.json");
    return parsed ? "" : parsed.message();
}

/// The sample's text with one piece of it put otherwise.
std::string sampleWith(const std::string& piece, const std::string& other) {
    std::string text = framesManifestText(sampleManifest());
    const std::size_t at = text.find(piece);
    EXPECT_NE(at, std::string::npos) << piece;
    return text.replace(at, piece.size(), other);
}

TEST(FramesManifestTest, IsReadBackAsItWasWritten) {
    const TempFolder folder;
    const auto file = folder / manifestName("walk");
    EXPECT_EQ(file.filename(), "walk.frames.json");
    ASSERT_TRUE(writeFramesManifest(file, sampleManifest()).ok());
    const auto read = readFramesManifest(file);
    ASSERT_TRUE(read) << read.message();
    EXPECT_EQ(read.value(), sampleManifest());
}

TEST(FramesManifestTest, HasALineForEachFrame) {
    const std::string text = framesManifestText(sampleManifest());
    EXPECT_THAT(text, HasSubstr("\n    {\"frame\":0,"));
    EXPECT_THAT(text, HasSubstr("},\n    {\"frame\":2,"));
}

TEST(FramesManifestTest, WithoutFramesIsReadBackToo) {
    FramesManifest manifest = sampleManifest();
    manifest.images.clear();
    const auto read = parseFramesManifest(framesManifestText(manifest), "walk.frames.json");
    ASSERT_TRUE(read) << read.message();
    EXPECT_EQ(read.value(), manifest);
}

TEST(FramesManifestTest, ThatIsDamagedIsTold) {
    constexpr const char* damaged = "walk.frames.json is damaged, or no list of recorded frames.";
    const std::string whole = framesManifestText(sampleManifest());
    EXPECT_EQ(messageFor(""), damaged);
    EXPECT_EQ(messageFor("[]"), damaged);
    EXPECT_EQ(messageFor(whole.substr(0, whole.size() / 2)), damaged);
    EXPECT_EQ(messageFor(sampleWith("quarn-frames", "quarn-recording")), damaged);
    EXPECT_EQ(messageFor(sampleWith("\"frames\": 3", "\"frames\": -3")), damaged);
    EXPECT_EQ(messageFor(sampleWith("\"frames\": 3", "\"frames\": 1e99")), damaged);
    EXPECT_EQ(messageFor(sampleWith("\"frame\":2", "\"frame\":0")), damaged);
    EXPECT_EQ(messageFor(sampleWith("0000000000000007", "zz")), damaged);
    EXPECT_EQ(messageFor(sampleWith("187.25", "\"noon\"")), damaged);
}

TEST(FramesManifestTest, NamesNoFileOutsideOfItsFolder) {
    FramesManifest manifest = sampleManifest();
    for (const char* name : {"../house000.jpg", "/etc/passwd", "..", ""}) {
        manifest.images[0].file = name;
        EXPECT_NE(messageFor(framesManifestText(manifest)), "") << name;
    }
}

TEST(FramesManifestTest, OfALaterVersionIsTold) {
    EXPECT_EQ(messageFor(sampleWith("\"version\": 1", "\"version\": 2")),
              "walk.frames.json was written by a later version of the program.");
}

TEST(FramesManifestTest, ThatIsMissingIsTold) {
    const auto read = readFramesManifest("/nowhere/walk.frames.json");
    ASSERT_FALSE(read);
    EXPECT_THAT(read.message(), HasSubstr("/nowhere/walk.frames.json cannot be read: "));
}

TEST(FrameRateTest, LetsAFilmLastFourSecondsWhereItCan) {
    EXPECT_EQ(standardFrameRate(1), 10);
    EXPECT_EQ(standardFrameRate(47), 10);
    EXPECT_EQ(standardFrameRate(48), 12);
    EXPECT_EQ(standardFrameRate(72), 15);
    EXPECT_EQ(standardFrameRate(80), 20);
    EXPECT_EQ(standardFrameRate(99), 24);
    EXPECT_EQ(standardFrameRate(100), 25);
    EXPECT_EQ(standardFrameRate(120), 30);
    EXPECT_EQ(standardFrameRate(1'000'000), 30);
}

TEST(FrameCameraTest, OfAPerspectiveViewHasItsLens) {
    KM_Viewport viewport;
    viewport.SetCameraLocation({10.0, 0.0, 0.0});
    viewport.SetCameraDirection({-2.0, 0.0, 0.0});
    viewport.SetCameraUp({1.0, 0.0, 3.0});
    viewport.SetTargetPoint({4.0, 0.0, 0.0});
    viewport.SetCamera35mmLensLength(35.0);
    const FrameCamera camera = frameCameraOf(viewport);
    EXPECT_EQ(camera.place, KM_3dPoint(10.0, 0.0, 0.0));
    EXPECT_EQ(camera.target, KM_3dPoint(4.0, 0.0, 0.0));
    EXPECT_NEAR(camera.up.z, 1.0, 1e-12);
    EXPECT_FALSE(camera.is_parallel);
    EXPECT_NEAR(camera.lens_mm, 35.0, 1e-9);
}

TEST(FrameCameraTest, OfAParallelViewHasWhatThePictureSpans) {
    KM_Viewport viewport;
    viewport.SetTargetPoint(KM_3dPoint::UnsetPoint);
    viewport.SetProjection(KM_parallel_view);
    viewport.SetFrustum(-4.0, 4.0, -3.0, 3.0, 1.0, 100.0);
    const FrameCamera camera = frameCameraOf(viewport);
    EXPECT_TRUE(camera.is_parallel);
    EXPECT_DOUBLE_EQ(camera.width, 8.0);
    EXPECT_DOUBLE_EQ(camera.height, 6.0);
    EXPECT_NEAR((camera.target - camera.place).Length(), 1.0, 1e-12);
}

} // namespace
} // namespace quarn::test
