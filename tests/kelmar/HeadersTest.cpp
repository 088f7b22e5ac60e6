// The umbrella header alone gives everything, and may be included twice.
#include "kelmar/kelmar.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

TEST(UmbrellaHeader, NamesEveryPublicHeader) {
    const std::filesystem::path folder = QUARN_SOURCE_DIR "/kelmar";
    std::ifstream file(folder / "kelmar.h");
    const std::string umbrella{std::istreambuf_iterator<char>(file), {}};
    ASSERT_FALSE(umbrella.empty());
    const std::string internal[] = {"kelmar.h", "KM_CaseFold.h", "KM_LittleEndian.h",
                                    "KM_SpanParameters.h"};
    for (const auto& entry : std::filesystem::directory_iterator(folder)) {
        const std::string name = entry.path().filename().string();
        if (entry.path().extension() != ".h" || std::ranges::count(internal, name) > 0)
            continue;
        EXPECT_NE(umbrella.find("\"kelmar/" + name + "\""), std::string::npos) << name;
    }
}
