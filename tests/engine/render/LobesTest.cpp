#include "engine/render/RenderSetupBuilder.h"
#include "engine/render/kernel/Glass.h"
#include "engine/render/kernel/RenderSetup.h"
#include "kelmar/KM_Point.h"

#include <gtest/gtest.h>

#include <cmath>
#include <numbers>
#include <vector>

namespace quarn {
namespace {

/// What one kind of surface does with light.
struct Surface {
    const char* name;
    float albedo;
    LookNumbers<float> numbers;
};

LookNumbers<float> looks(float metalness, float roughness, float f0, float coat = 0.0F,
                         float coat_roughness = 0.0F) {
    LookNumbers<float> numbers = matt_look;
    numbers.metalness = metalness;
    numbers.roughness = roughness;
    for (float& number : numbers.f0)
        number = f0;
    numbers.f90 = 1.0F;
    numbers.clearcoat = coat;
    numbers.clearcoat_roughness = coat_roughness;
    return numbers;
}

const std::vector<Surface> surfaces{
    {"smooth metal", 1.0F, looks(1.0F, 0.2F, 0.04F)},
    {"rough metal", 0.9F, looks(1.0F, 0.9F, 0.04F)},
    {"glossy plastic", 0.8F, looks(0.0F, 0.3F, 0.04F)},
    {"rough plastic", 0.8F, looks(0.0F, 0.8F, 0.04F)},
    {"white half metal", 1.0F, looks(0.5F, 0.5F, 0.04F)},
    {"coated", 0.7F, looks(0.0F, 0.6F, 0.04F, 1.0F, 0.25F)},
    {"coated metal", 0.9F, looks(1.0F, 0.4F, 0.04F, 0.6F, 0.3F)},
};

const RenderSetup& plainSetup() {
    static RenderTables tables;
    static const RenderSetup setup = [] {
        RenderSetup made;
        made.frame.has_mirrors = true;
        made.frame.split_sum = splitSum().entries();
        completeRenderSetup(made, renderKernelInForce(), tables);
        return made;
    }();
    return setup;
}

LaneVectors everywhere(const KM_3dVector& v) {
    return {static_cast<float>(v.x), static_cast<float>(v.y), static_cast<float>(v.z)};
}

KM_3dVector directionAt(double angle_deg, double turn_deg) {
    const double angle = angle_deg * std::numbers::pi / 180.0;
    const double turn = turn_deg * std::numbers::pi / 180.0;
    return {std::sin(angle) * std::cos(turn), std::sin(angle) * std::sin(turn), std::cos(angle)};
}

/// A surface whose normal is (0, 0, 1), seen by an observer.
struct Seen {
    LookLanes look;
    LobeLanes lobes;

    Seen(const Surface& surface, const KM_3dVector& observer) {
        const LaneVectors up{0.0F, 0.0F, 1.0F};
        look = mattLooks(up);
        setNumbers(~noLanes(), surface.numbers, look.numbers);
        look.mirrors = ~noLanes();
        SurfaceLanes lanes;
        lanes.face = lanes.normal = up;
        lanes.albedo = {surface.albedo, surface.albedo, surface.albedo};
        RayPacket packet;
        setDirection(packet.rays.ray, everywhere(-observer));
        startLobes(plainSetup(), packet, lanes, &look, lobes);
    }

    SentLanes from(const LaneVectors& toward) const {
        return sentFrom(plainSetup(), lobes, &look, toward);
    }
    double brightnessFrom(const KM_3dVector& toward) const {
        const SentLanes sent = from(everywhere(toward));
        return double{laneOf(sent.matt.g, 0)} + double{laneOf(sent.gloss.g, 0)};
    }
};

TEST(Lobes, DensityOfDirectionsIsOneOverAllOfThem) {
    constexpr int rings = 1200;
    constexpr int turns = 1200;
    for (const Surface& surface : surfaces)
        for (const double angle : {0.0, 40.0, 75.0}) {
            const KM_3dVector observer = directionAt(angle, 0.0);
            const Seen seen(surface, observer);
            double sum = 0.0;
            for (int i = 0; i < rings; ++i) {
                const double z = 1.0 - 2.0 * (i + 0.5) / rings;
                const double across = std::sqrt(1.0 - z * z);
                for (int j = 0; j < turns; j += lane_count) {
                    LaneVectors toward{0.0F, 0.0F, static_cast<float>(z)};
                    for (int lane = 0; lane < lane_count; ++lane) {
                        const double turn = 2.0 * std::numbers::pi * (j + lane + 0.5) / turns;
                        reinterpret_cast<float*>(&toward.x)[lane] =
                            static_cast<float>(across * std::cos(turn));
                        reinterpret_cast<float*>(&toward.y)[lane] =
                            static_cast<float>(across * std::sin(turn));
                    }
                    const SentLanes sent = seen.from(toward);
                    // No small mirror would send light so far down.
                    for (int lane = 0; lane < lane_count && z + observer.z > 0.0; ++lane)
                        sum += double{laneOf(sent.density, lane)};
                }
            }
            const double each = 4.0 * std::numbers::pi / (double{rings} * turns);
            EXPECT_NEAR(sum * each, 1.0, 0.025) << surface.name << ' ' << angle;
        }
}

TEST(Lobes, LightTakesEachWayBackAsItCame) {
    for (const Surface& surface : surfaces)
        for (const double a : {5.0, 35.0, 70.0})
            for (const double b : {0.0, 50.0, 80.0}) {
                const KM_3dVector one = directionAt(a, 0.0);
                const KM_3dVector other = directionAt(b, 110.0);
                const double there = Seen(surface, one).brightnessFrom(other) / other.z;
                const double back = Seen(surface, other).brightnessFrom(one) / one.z;
                EXPECT_NEAR(there, back, 0.002 + 0.01 * back)
                    << surface.name << ' ' << a << ' ' << b;
            }
}

/// The part of even light that comes off, by the rays that the surface would send.
double sentOfEvenLight(const Seen& seen) {
    constexpr int side = 256;
    constexpr float golden = 0.61803399F; // its multiples are well spread between whole numbers
    double sum = 0.0;
    for (int i = 0; i < side; ++i)
        for (int j = 0; j < side; j += lane_count) {
            const Lanes column = floatsOf(laneNumbers()) + static_cast<float>(j);
            LanePlaces place;
            place.u = (static_cast<float>(i) + 0.5F) / side;
            place.v = (column + 0.5F) * (1.0F / side);
            const Lanes turns = (column + static_cast<float>(i * side)) * golden;
            const Lanes choice = turns - floatsOf(wholePart(turns));
            const NextRay next = nextRay(plainSetup(), seen.lobes, &seen.look, choice, place);
            for (int lane = 0; lane < lane_count; ++lane)
                sum += double{laneOf(next.matt.g, lane)} + double{laneOf(next.gloss.g, lane)};
        }
    return sum / (side * side);
}

TEST(Lobes, WhiteMirrorsOfEveryRoughnessSendAllLightOn) {
    for (const float metalness : {0.0F, 1.0F})
        for (float roughness = 0.0F; roughness <= 1.0F; roughness += 0.125F)
            for (const double angle : {0.0, 30.0, 60.0, 80.0}) {
                const Seen seen({"white", 1.0F, looks(metalness, roughness, 0.04F)},
                                directionAt(angle, 0.0));
                EXPECT_NEAR(sentOfEvenLight(seen), 1.0, 0.01)
                    << metalness << ' ' << roughness << ' ' << angle;
            }
}

TEST(Lobes, NoSurfaceSendsMoreLightThanItGets) {
    for (const Surface& surface : surfaces)
        for (const double angle : {0.0, 45.0, 70.0, 85.0})
            EXPECT_LE(sentOfEvenLight(Seen(surface, directionAt(angle, 0.0))), 1.01)
                << surface.name << ' ' << angle;
}

TEST(Lobes, BorderMirrorsAsFresnelSays) {
    // E. Hecht, "Optics", 4.6: from air into glass of index 1.5 four parts in a hundred come back
    // straight on, and at Brewster's angle half of the 14.8 percent that are mirrored across.
    Lanes beyond;
    EXPECT_NEAR(laneOf(mirroredByBorder(1.0F, 1.0F / 1.5F, beyond), 0), 0.04, 1e-5);
    const auto brewster = static_cast<float>(std::cos(std::atan(1.5)));
    EXPECT_NEAR(laneOf(mirroredByBorder(brewster, 1.0F / 1.5F, beyond), 0), 0.074, 1e-3);
    // Beyond 41.8 degrees nothing leaves glass.
    const auto steep = static_cast<float>(std::cos(42.0 * std::numbers::pi / 180.0));
    EXPECT_EQ(laneOf(mirroredByBorder(steep, 1.5F, beyond), 0), 1.0F);
    EXPECT_NEAR(laneOf(mirroredByBorder(0.3F, 1.0F, beyond), 0), 0.0F, 1e-9F);
}

TEST(Lobes, ExponentialFallsAsItsTableSays) {
    for (const float x : {0.0F, -0.01F, -0.5F, -1.0F, -7.25F, -40.0F})
        EXPECT_NEAR(laneOf(exponential(x), 0) / std::exp(x), 1.0F, 1e-5F) << x;
    EXPECT_LT(laneOf(exponential(-1e30F), 0), 1e-30F);
}

} // namespace
} // namespace quarn
