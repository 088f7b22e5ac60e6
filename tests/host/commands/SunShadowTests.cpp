#include "host/document/Document.h"
#include "host/document/DocumentDrawing.h"
#include "tests/engine/display/DisplayFixture.h"
#include "tests/host/app/TestCommand.h"

namespace quarn::test {
namespace {

/// A pole, one unit wide and three high, seen from above: 200 pixels show 20 units, north is up.
class SunShadowTest : public HostTest {
protected:
    SunShadowTest() {
        Document& document = Document::of(session.document());
        document.objects().addMesh(L"Pole", {shared(boxMesh({-0.5, -0.5, 0}, {0.5, 0.5, 3}))});
    }

    /// The picture after a command.
    Image after(const wchar_t* line) {
        EXPECT_EQ(run(line), CQuarnCommand::success) << KM_wString(line).ToUtf8();
        Image picture;
        const Result<void> is_drawn =
            Document::of(session.document())
                .drawing()
                .draw(topView(10), modeNamed(L"Rendered"), 200, 200, picture);
        EXPECT_TRUE(is_drawn);
        return picture;
    }

    /// Whether the ground lies in shadow so many units east and north of the pole, by comparison
    /// with the ground across.
    static bool isInShadow(const Image& picture, double east, double north) {
        const auto brightnessAt = [&](double x, double y) {
            return brightness(picture, static_cast<int>(100 + 10 * x),
                              static_cast<int>(100 - 10 * y));
        };
        return brightnessAt(east, north) < 0.85 * brightnessAt(-east, -north);
    }
};

TEST_F(SunShadowTest, FallsToTheWestOfASunInTheEastAndToTheEastOfOneInTheWest) {
    const Image morning = after(L"_-Sun _Direction 90 45");
    EXPECT_TRUE(isInShadow(morning, -2, 0));
    EXPECT_FALSE(isInShadow(morning, 2, 0));
    const Image evening = after(L"_-Sun _Direction 270 45");
    EXPECT_TRUE(isInShadow(evening, 2, 0));
    EXPECT_FALSE(isInShadow(evening, -2, 0));
}

// At an equinox the noon sun stands 90 degrees less the latitude high: the shadow of three units
// reaches 3 * tan(51.51 degrees) = 3.77 units beyond the pole's side at 0.5, to 4.27.
TEST_F(SunShadowTest, AtNoonOfAnEquinoxPointsNorthAndIsAsLongAsTheLatitudeSays) {
    const Image noon = after(L"_-Sun _PlaceAndTime London 2026-03-20 12:08");
    EXPECT_TRUE(isInShadow(noon, 0, 1));
    EXPECT_TRUE(isInShadow(noon, 0, 4.15));
    EXPECT_FALSE(isInShadow(noon, 0, 4.4));
    EXPECT_FALSE(isInShadow(noon, 0.8, 2));
    EXPECT_FALSE(isInShadow(noon, -0.8, 2));
}

// South of the tropics the noon sun stands in the north.
TEST_F(SunShadowTest, AtNoonPointsSouthOnTheSouthernHemisphere) {
    const Image noon = after(L"_-Sun _PlaceAndTime Sydney 2026-06-21 12:00");
    EXPECT_TRUE(isInShadow(noon, 0, -2));
    EXPECT_FALSE(isInShadow(noon, 0, 2));
}

TEST_F(SunShadowTest, TurnsWithTheNorthOfTheModel) {
    const Image noon = after(L"_-Sun _PlaceAndTime London 2026-03-20 12:08 _NorthAngle 90 _Enter");
    EXPECT_TRUE(isInShadow(noon, 4.15, 0)); // north lies along the X axis
    EXPECT_FALSE(isInShadow(noon, 4.4, 0));
    EXPECT_FALSE(isInShadow(noon, 0, 2));
}

TEST_F(SunShadowTest, IsGoneWithTheSunOff) {
    ASSERT_TRUE(isInShadow(after(L"_-Sun _Direction 90 45"), -2, 0));
    EXPECT_FALSE(isInShadow(after(L"_-Sun _Off"), -2, 0));
    EXPECT_TRUE(isInShadow(after(L"_-Sun _On"), -2, 0));
}

} // namespace
} // namespace quarn::test
