#include "import/ifc/IfcPlace.h"

#include <gtest/gtest.h>

#include <string>

namespace quarn::test {
namespace {

std::string fileWith(const std::string& latitude, const std::string& longitude,
                     const std::string& north = "$") {
    return "ISO-10303-21;\nDATA;\n"
           "#5= IFCGEOMETRICREPRESENTATIONSUBCONTEXT('Body','Model',*,*,*,*,#4,$,.MODEL_VIEW.,$);\n"
           "#4= IFCGEOMETRICREPRESENTATIONCONTEXT($,'Model',3,1.E-05,#6," +
           north +
           ");\n"
           "#7=IFCDIRECTION((0.5,0.866025403784439,0.));\n"
           "#8=IFCSITE('2O2Fr$t4X7Zf8NOew3FLOH',#1,'It''s here, (by the lake)',$,$,#9,$,$,"
           ".ELEMENT.," +
           latitude + "," + longitude + ",430.,$,$);\nENDSEC;\n";
}

std::optional<ImportedPlace> placeIn(const std::string& text) {
    return placeOfIfc({reinterpret_cast<const std::uint8_t*>(text.data()), text.size()});
}

TEST(IfcPlace, IsTheSitesInDegreesMinutesSecondsAndMillionths) {
    const auto zurich = placeIn(fileWith("(47,22,40,500000)", "(8,32,30)"));
    ASSERT_TRUE(zurich);
    EXPECT_NEAR(zurich->latitude_deg, 47 + 22 / 60.0 + 40.5 / 3600.0, 5e-7);
    EXPECT_NEAR(zurich->longitude_deg, 8 + 32 / 60.0 + 30 / 3600.0, 5e-7);
    EXPECT_EQ(zurich->north_angle_deg, 0.0);
}

TEST(IfcPlace, SouthAndWestAreNegativeInAllParts) {
    const auto lima = placeIn(fileWith("(-12,-2,-45,0)", "(-77,-1,-50,0)"));
    ASSERT_TRUE(lima);
    EXPECT_NEAR(lima->latitude_deg, -(12 + 2 / 60.0 + 45 / 3600.0), 5e-7);
    EXPECT_NEAR(lima->longitude_deg, -(77 + 1 / 60.0 + 50 / 3600.0), 5e-7);
}

TEST(IfcPlace, TrueNorthIsTheDirectionOfTheWholeModelsContext) {
    const auto place = placeIn(fileWith("(47,22,40)", "(8,32,30)", "#7"));
    ASSERT_TRUE(place);
    EXPECT_NEAR(place->north_angle_deg, 30.0, 5e-7);
}

TEST(IfcPlace, WhatIsNoPlaceIsNone) {
    EXPECT_FALSE(placeIn(fileWith("$", "$")));
    EXPECT_FALSE(placeIn(fileWith("(47)", "(8,32,30)")));
    EXPECT_FALSE(placeIn(fileWith("(91,0,0)", "(8,32,30)")));
    EXPECT_FALSE(placeIn(fileWith("(nan,0,0)", "(8,32,30)")));
    EXPECT_FALSE(placeIn(fileWith("(47,22,x)", "(8,32,30)")));
    EXPECT_FALSE(placeIn(""));
    EXPECT_EQ(placeIn(fileWith("(47,22,40)", "(8,32,30)", "#77"))->north_angle_deg, 0.0);
}

TEST(IfcPlace, AFileCutAnywhereIsReadWithoutHarm) {
    const std::string whole = fileWith("(47,22,40)", "(8,32,30)", "#7");
    for (std::size_t length = 0; length < whole.size(); ++length) {
        const auto place = placeIn(whole.substr(0, length));
        EXPECT_TRUE(!place || place->latitude_deg > 47.0) << length;
    }
}

} // namespace
} // namespace quarn::test
