// A program that checks its memory reserves more addresses than any limit allows.
#if !defined(__SANITIZE_ADDRESS__)

#include "tests/quarn/Studio.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::HasSubstr;

/// Runs a script with at most so much memory.
Ended runWithin(int megabytes, const std::filesystem::path& folder, const std::string& script) {
    writeFile(folder / "steps.txt", script);
    Start start;
    start.folder = folder;
    start.program = "/bin/sh";
    start.arguments = {"-c", "ulimit -v " + std::to_string(1024 * megabytes) + "; exec '" +
                                 QUARN_PROGRAM + "' run steps.txt --language en"};
    return run(start);
}

TEST(LittleMemory, APictureThatDoesNotFitIsTold) {
    const TempFolder folder;
    // 16384 * 16384 pixels of 4 bytes are 1024 MB.
    const Ended ended =
        runWithin(900, folder.path(),
                  "_-SetTurntableAnimation 3 _Clockwise _png _Wireframe _Enter _Enter\n"
                  "_-SaveFrame _Size 16384 16384 0 large.png\n");
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(ended.out, HasSubstr("A picture of 16384 by 16384 pixels cannot be drawn: there is "
                                     "too little memory."));
    EXPECT_FALSE(std::filesystem::exists(folder / "large.png"));
}

TEST(LittleMemory, ASizeThatDoesNotFitIsRefusedBeforeAnythingIsDrawn) {
    const Studio studio;
    // 16384 * 16384 pixels of 18 bytes are 4.5 GB.
    const Ended ended =
        runWithin(900, studio.path(),
                  "_-Import house.obj\n_-ViewportSize 16384 16384\n"
                  "_-SetTurntableAnimation 3 _Clockwise _png _Shaded _Enter _Enter\n"
                  "_-RecordAnimation out\n");
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(ended.out + ended.err,
                HasSubstr("A picture of 16384 by 16384 pixels cannot be drawn: there is too little "
                          "memory. It needs 4.5 GB, and 0."));
    EXPECT_FALSE(std::filesystem::exists(studio / "out"));
}

TEST(LittleMemory, RayTracingThatDoesNotFitIsToldAsThatAndEnds) {
    const Studio studio;
    const Ended ended =
        runWithin(180, studio.path(),
                  "_-Import house.obj\n_-RenderSettings _Size 48 32 _PreviewSamples 1 _Enter\n"
                  "_-RenderPreview\n");
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(ended.out, HasSubstr("The scene cannot be drawn: there is too little memory."));
}

} // namespace
} // namespace quarn::test

#endif
