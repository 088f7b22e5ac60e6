#include "tests/quarn/Studio.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

constexpr const char* TEXTURE_GONE = "The texture 'gone.png' was left out: there is no such file "
                                     "beside the model.";

/// A triangle with a material whose texture is not there, used by two objects.
void writePainted(const Studio& studio) {
    writeFile(studio / "paint.mtl", "newmtl paint\nKd 0.8 0.2 0.1\nmap_Kd gone.png\n");
    writeFile(studio / "painted.obj",
              "mtllib paint.mtl\nv 0 0 0\nv 1 0 0\nv 0 0 1\nvt 0 0\nvt 1 0\nvt 0 1\n"
              "usemtl paint\no one\nf 1/1 2/2 3/3\no two\nf 3/3 2/2 1/1\n");
}

Ended runIn(const Studio& studio, std::vector<std::string> arguments) {
    Start start;
    start.folder = studio.path();
    start.arguments = std::move(arguments);
    return run(start);
}

TEST(ModelDefect, IsToldOnceWhenAModelIsRecorded) {
    const Studio studio;
    writePainted(studio);
    const Ended ended = run(studio.turntableOf("painted.obj", 2));
    EXPECT_EQ(ended.exit_code, 0);
    EXPECT_THAT(linesOf(ended.err),
                ElementsAre(std::string("quarn: painted.obj: ") + TEXTURE_GONE));
    EXPECT_THAT(ended.out, Not(HasSubstr("gone.png")));
}

TEST(ModelDefect, IsToldOnceByInfo) {
    const Studio studio;
    writePainted(studio);
    const Ended ended = runIn(studio, {"info", "painted.obj"});
    EXPECT_EQ(ended.exit_code, 0);
    EXPECT_THAT(linesOf(ended.err),
                ElementsAre(std::string("quarn: painted.obj: ") + TEXTURE_GONE));
    EXPECT_THAT(ended.out, Not(HasSubstr("gone.png")));
    EXPECT_THAT(ended.out, HasSubstr("2 meshes"));
}

TEST(ModelDefect, StandsAmongTheWordsOfTheHostWhereTheyAreShown) {
    const Studio studio;
    writePainted(studio);
    const Ended ended = run(studio.turntableOf("painted.obj", 1, {"--verbose"}));
    EXPECT_EQ(ended.exit_code, 0);
    EXPECT_THAT(ended.err, IsEmpty());
    EXPECT_THAT(ended.out, HasSubstr(TEXTURE_GONE));
}

TEST(ModelDefect, ThereIsNoneInASoundModel) {
    const Studio studio;
    EXPECT_THAT(run(studio.turntable(1)).err, IsEmpty());
    EXPECT_THAT(runIn(studio, {"info", "house.obj"}).err, IsEmpty());
}

} // namespace
} // namespace quarn::test
