#include "host/share/viewer/PagePictures.h"
#include "host/share/viewer/PageRecording.h"

#include <cmath>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>
#include <numbers>
#include <set>

namespace quarn::test {
namespace {

using testing::ElementsAre;
using Json = nlohmann::json;

FramesManifest turntable(int frames, double degrees_a_frame) {
    FramesManifest manifest;
    manifest.name = "House";
    manifest.kind = "turntable";
    manifest.frames = frames;
    for (int number = 0; number < frames; ++number) {
        const double angle = number * degrees_a_frame * std::numbers::pi / 180.0;
        ManifestFrame frame;
        frame.number = number;
        frame.file = "House00" + std::to_string(number) + ".jpg";
        frame.camera = FrameCamera{};
        frame.camera->place = {100.0 + std::cos(angle), 50.0 + std::sin(angle), 3.0};
        frame.camera->target = {100.0, 50.0, 0.0};
        manifest.images.push_back(frame);
    }
    return manifest;
}

Json jsonOf(const FramesManifest& manifest) {
    return Json::parse(pageRecordingJson({"A title", false, 640, 360, manifest}));
}

TEST(CoarseToFine, BeginsWithEvery8thAndHasEveryFrameOnce) {
    EXPECT_THAT(coarseToFine(10), ElementsAre(0, 8, 4, 2, 6, 1, 3, 5, 7, 9));
    EXPECT_THAT(coarseToFine(1), ElementsAre(0));
    for (const int frames : {2, 61, 513, 10000}) {
        const std::vector<int> order = coarseToFine(frames);
        EXPECT_EQ(std::set<int>(order.begin(), order.end()).size(), order.size());
        EXPECT_EQ(order.size(), static_cast<std::size_t>(frames));
    }
}

TEST(CoarseToFine, SeesALongRecordingWholeInItsFirst64) {
    const std::vector<int> order = coarseToFine(10000);
    EXPECT_THAT(std::vector<int>(order.begin(), order.begin() + 3), ElementsAre(0, 256, 512));
    EXPECT_EQ(order[39], 9984);
}

// A camera that goes round anticlockwise, seen from above, makes the model turn clockwise, whose
// near side then goes to the left, as the hand of a clock does at six.
TEST(TurnOfTheModel, IsToTheLeftWhereTheCameraGoesAnticlockwise) {
    EXPECT_EQ(turnOf(turntable(8, 45.0)), -1);
    EXPECT_EQ(turnOf(turntable(8, -45.0)), 1);
}

TEST(TurnOfTheModel, IsThatOfTheFramesThatAreThere) {
    FramesManifest manifest = turntable(8, -45.0);
    manifest.images.erase(manifest.images.begin() + 2, manifest.images.begin() + 6);
    EXPECT_EQ(turnOf(manifest), 1);
}

TEST(TurnOfTheModel, IsClockwiseWhereNobodyTells) {
    FramesManifest manifest = turntable(8, -45.0);
    for (ManifestFrame& frame : manifest.images)
        frame.camera.reset();
    EXPECT_EQ(turnOf(manifest), -1);
}

TEST(PageRecording, KeepsThePlacesOfMissingFramesInATurn) {
    FramesManifest manifest = turntable(6, 60.0);
    manifest.images.pop_back();
    manifest.images.erase(manifest.images.begin());
    const Json json = jsonOf(manifest);
    EXPECT_EQ(json["count"], 6);
    EXPECT_EQ(json["first"], 1);
    EXPECT_EQ(json["files"], Json::parse(R"([null, "House001.jpg", "House002.jpg", "House003.jpg",
                                             "House004.jpg", null])"));
}

TEST(PageRecording, OfAWalkEndsWithItsLastPicture) {
    FramesManifest manifest = turntable(6, 60.0);
    manifest.kind = "flythrough";
    manifest.images.pop_back();
    const Json json = jsonOf(manifest);
    EXPECT_EQ(json["kind"], "walk");
    EXPECT_EQ(json["count"], 5);
    EXPECT_EQ(json["turn"], 1);
}

TEST(PageRecording, OfAStudyHasTimeAndSunOfEachFrame) {
    FramesManifest manifest = turntable(2, 0.0);
    manifest.kind = "one_day_sun";
    manifest.images[0].sun = FrameSun{"2026-06-21T04:00:00", "UTC+1", 57.25, -3.5};
    manifest.place = "Athens, Greece";
    const Json json = jsonOf(manifest);
    EXPECT_EQ(json["kind"], "study");
    EXPECT_EQ(json["place"], "Athens, Greece");
    EXPECT_EQ(json["suns"],
              Json::parse(R"([["2026-06-21T04:00:00", "UTC+1", 57.25, -3.5], null])"));
    manifest.images[0].sun.reset();
    EXPECT_TRUE(jsonOf(manifest)["suns"].is_null());
}

TEST(PageRecording, PlaysAtTheRateOfTheManifest) {
    FramesManifest manifest = turntable(8, 45.0);
    EXPECT_EQ(jsonOf(manifest)["rate"], 10);
    manifest.frame_rate = 24;
    EXPECT_EQ(jsonOf(manifest)["rate"], 24);
}

} // namespace
} // namespace quarn::test
