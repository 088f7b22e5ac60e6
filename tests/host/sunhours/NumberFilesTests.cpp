#include "host/sunhours/HourColors.h"
#include "host/sunhours/NumberFiles.h"
#include "host/sunhours/PlanView.h"

#include "engine/display/DisplayScene.h"
#include "ground/FileBytes.h"

#include <gtest/gtest.h>

#include <cmath>
#include <cstring>

namespace quarn {
namespace {

TEST(NumberFilesTests, ShareOfAnObjectCountsPointsFromTheThresholdOn) {
    SurfacePoints points(1.0);
    for (const float up : {1.0F, 0.0F, 1.0F, -1.0F, 1.0F})
        points.add({{0, 0, 0}, {up == 0.0F ? 1.0F : 0.0F, 0, up}});
    SunLight light;
    light.hours = {9.0F, 0.0F, 1.0F, 2.0F, 5.0F};
    const ObjectHours sums = hoursOf({0, 1, 4, 8.0}, points, light, 2.0);
    EXPECT_DOUBLE_EQ(sums.mean_hours, 2.0);
    EXPECT_DOUBLE_EQ(sums.share, 0.5);
    EXPECT_DOUBLE_EQ(sums.up_area, 4.0);
    EXPECT_DOUBLE_EQ(sums.up_mean_hours, 3.0);
    EXPECT_DOUBLE_EQ(sums.up_share, 0.5);
    EXPECT_EQ(hoursOf({0, 0, 0, 0.0}, points, light, 2.0).mean_hours, 0.0);
}

TEST(NumberFilesTests, TableQuotesNamesAndNamesItsThreshold) {
    EXPECT_EQ(
        objectsCsv({{"South \"wall\", long", 12.5, 3.25, 0.75, 16, 4.5, 6.0, 1.0}}, 2.0, "m2"),
        "object,area_m2,mean_hours,share_from_2_hours,points,"
        "up_area_m2,up_mean_hours,up_share_from_2_hours\r\n"
        "\"South \"\"wall\"\", long\",12.5,3.250,0.7500,16,4.5,6.000,1.0000\r\n");
}

/// A floor that fills the right half of a plan of 8 by 4 pixels.
SunHoursMap halfMap() {
    auto mesh = std::make_shared<KM_Mesh>();
    mesh->m_V = {{0, -2, 0}, {4, -2, 0}, {4, 2, 0}, {0, 2, 0}};
    mesh->m_F = {{{0, 1, 2}}, {{0, 2, 3}}};
    SceneContent content;
    content.meshes.push_back({{mesh, nullptr, {}}, KM_CreateUuid()});
    DisplayScene scene;
    EXPECT_TRUE(scene.update(content).ok());
    KM_BoundingBox box;
    box.Set(KM_3dPoint(-4, -1.9, -1));
    box.Set(KM_3dPoint(4, 1.9, 1));
    SunHoursRequest request;
    request.width_px = 8;
    request.height_px = 4;
    SunMoments moments;
    moments.days = 1;
    moments.hours = 3.0;
    moments.moments.push_back({{}, {KM_3dVector(0, 0, 1), 3.0}});
    return *mapOf(scene, planView(box, 8, 4), request, moments, [](double) { return true; });
}

TEST(NumberFilesTests, ArrayHoldsTheHoursOfPixelsAndNoNumberWhereNothingIsSeen) {
    const auto file = std::filesystem::temp_directory_path() / "quarn-hours-test.npy";
    ASSERT_TRUE(writeHoursArray(file, halfMap()).ok());
    const auto bytes = readFileBytes(file);
    std::filesystem::remove(file);
    ASSERT_TRUE(bytes.ok());
    const auto all = bytes.value().bytes();
    const std::size_t header = 10U + all[8] + 256U * all[9];
    EXPECT_EQ(header % 64, 0U);
    ASSERT_EQ(all.size(), header + 8 * 4 * sizeof(float));
    const std::string text(all.begin() + 10, all.begin() + static_cast<std::ptrdiff_t>(header));
    EXPECT_NE(text.find("'shape': (4, 8)"), text.npos);
    for (std::size_t i = 0; i < 32; ++i) {
        float hours = 0.0F;
        std::memcpy(&hours, all.data() + header + i * sizeof hours, sizeof hours);
        if (i % 8 < 4)
            EXPECT_TRUE(std::isnan(hours)) << i;
        else
            EXPECT_EQ(hours, 3.0F) << i;
    }
}

TEST(NumberFilesTests, ScaleOfColoursRunsFromVioletToYellowAndEndsWithWholeHours) {
    EXPECT_EQ(viridis(0.0), KM_Color(68, 1, 84, 255));
    EXPECT_EQ(viridis(0.5), KM_Color(33, 145, 140, 255));
    EXPECT_EQ(viridis(1.0), KM_Color(253, 231, 37, 255));
    EXPECT_EQ(viridis(7.0), viridis(1.0));
    EXPECT_EQ(endOfScale(11.2), 12.0);
    EXPECT_EQ(endOfScale(12.0), 12.0);
    EXPECT_EQ(endOfScale(0.0), 1.0);
}

} // namespace
} // namespace quarn
