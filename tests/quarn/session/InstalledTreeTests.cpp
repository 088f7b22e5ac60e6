#include "tests/quarn/Studio.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::HasSubstr;
using testing::SizeIs;

/// The tree that the built program stands in, copied to a folder; the libraries are links.
void copyTree(const std::filesystem::path& to, bool with_plug_ins) {
    const std::filesystem::path built = std::filesystem::path(QUARN_PROGRAM).parent_path() / "..";
    std::filesystem::create_directories(to / "bin");
    std::filesystem::create_directories(to / "lib/quarn");
    std::filesystem::copy_file(QUARN_PROGRAM, to / "bin/quarn");
    for (const auto& entry : std::filesystem::directory_iterator(built / "lib"))
        if (!entry.is_directory())
            std::filesystem::create_symlink(std::filesystem::canonical(entry.path()),
                                            to / "lib" / entry.path().filename());
    if (with_plug_ins)
        std::filesystem::copy(built / "lib/quarn/plug-ins", to / "lib/quarn/plug-ins");
}

TEST(InstalledTree, ProgramRunsFromAnyPlaceThatItsTreeIsCopiedTo) {
    const Studio studio;
    copyTree(studio / "some where", true);
    Start start = studio.turntable(1);
    start.program = studio / "some where/bin/quarn";
    const Ended ended = run(start);
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_TRUE(std::filesystem::exists(studio / "out/house000.jpg"));
}

TEST(InstalledTree, ProgramRunsThroughALink) {
    const Studio studio;
    std::filesystem::create_symlink(QUARN_PROGRAM, studio / "linked");
    Start start = studio.turntable(1);
    start.program = studio / "linked";
    EXPECT_EQ(run(start).exit_code, 0);
}

TEST(InstalledTree, MissingPlugInIsToldByItsPath) {
    const Studio studio;
    copyTree(studio / "tree", false);
    Start start = studio.turntable(1);
    start.program = studio / "tree/bin/quarn";
    const Ended ended = run(start);
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(linesOf(ended.err), SizeIs(1));
    EXPECT_THAT(ended.err, HasSubstr("tree/lib/quarn/plug-ins/Zoetrix.qnp"));
}

} // namespace
} // namespace quarn::test
