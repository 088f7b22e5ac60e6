#include "import/ModelFormats.h"

#include <gmock/gmock.h>

#include <set>

namespace quarn::test {
namespace {

using testing::IsSupersetOf;

TEST(ModelFormats, TheUsualModelFilesComeFirstAndNoneTwice) {
    const std::vector<std::string> endings = modelFileExtensions();
    ASSERT_GT(endings.size(), 10U);
    EXPECT_EQ(endings[0], "glb");
    EXPECT_EQ(endings[1], "gltf");
    EXPECT_EQ(endings[2], "obj");
    EXPECT_THAT(endings, IsSupersetOf({"fbx", "dae", "stl", "ply", "3mf", "off"}));
    EXPECT_EQ(std::set<std::string>(endings.begin(), endings.end()).size(), endings.size());
    for (const std::string& ending : endings)
        EXPECT_EQ(ending.find_first_of(".*;ABCDEFGHIJKLMNOPQRSTUVWXYZ"), std::string::npos)
            << ending;
}

} // namespace
} // namespace quarn::test
