#include "tests/quarn/Studio.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::HasSubstr;
using testing::IsEmpty;
using testing::SizeIs;
using testing::StartsWith;

std::string littleEndian32(std::uint32_t value) {
    std::string bytes;
    for (int shift = 0; shift < 32; shift += 8)
        bytes += static_cast<char>(value >> shift & 0xFF);
    return bytes;
}

/// The header promises 12 triangles, the file ends in the second one.
std::string truncatedStl() {
    return std::string(80, ' ') + littleEndian32(12) + std::string(50, '\0') + std::string(17, 'x');
}

/// The header promises 100 vertices and 100 faces; a handful of bytes follow.
std::string truncatedPly() {
    return "ply\nformat binary_little_endian 1.0\nelement vertex 100\nproperty float x\n"
           "property float y\nproperty float z\nelement face 100\n"
           "property list uchar int vertex_indices\nend_header\n" +
           std::string(500, '\x01');
}

/// Says that it is 1000 bytes long.
std::string truncatedGlb() {
    return "glTF" + littleEndian32(2) + littleEndian32(1000) + littleEndian32(900) + "JSON{\"as";
}

struct BadModel {
    const char* name;
    std::string bytes;
};

/// Model files that hold nothing to look at.
std::vector<BadModel> badModels() {
    return {
        {"empty.obj", ""},
        {"empty.glb", ""},
        {"empty.ply", ""},
        {"empty.stl", ""},
        {"cut.stl", truncatedStl()},
        {"cut.ply", truncatedPly()},
        {"cut.glb", truncatedGlb()},
        {"noise.glb", std::string(4096, '\xA5')},
        {"vertices.obj", "o nothing\n"},
        {"far_index.obj", "v 0 0 0\nv 1 0 0\nv 0 1 0\nf 1 2 99\n"},
        {"not_a_number.obj", "v nan 0 0\nv 1 nan 0\nv 0 1 nan\nf 1 2 3\n"},
        {"text.gltf", "{ \"asset\": "},
        {"unknown.xyzzy", "what is this"},
    };
}

class ModelThatCannotBeShown : public testing::TestWithParam<BadModel> {};

TEST_P(ModelThatCannotBeShown, IsToldByNameAndNothingIsWritten) {
    const BadModel& model = GetParam();
    const Studio studio;
    writeFile(studio / model.name, model.bytes);
    const Ended ended = run(studio.turntableOf(model.name, 2));
    EXPECT_EQ(ended.killed_by, 0);
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(ended.out, IsEmpty());
    EXPECT_THAT(linesOf(ended.err), SizeIs(1)) << ended.err;
    EXPECT_THAT(ended.err, StartsWith("quarn: "));
    EXPECT_THAT(ended.err, HasSubstr(model.name));
    EXPECT_FALSE(std::filesystem::exists(studio / "out"));
    EXPECT_EQ(readFile(studio / model.name), model.bytes);
}

INSTANTIATE_TEST_SUITE_P(BadModel, ModelThatCannotBeShown, testing::ValuesIn(badModels()),
                         [](const auto& instance) {
                             std::string name = instance.param.name;
                             std::replace(name.begin(), name.end(), '.', '_');
                             return name;
                         });

TEST(BadModel, MissingFileIsTold) {
    const Studio studio;
    const Ended ended = run(studio.turntableOf("missing.obj", 2));
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(linesOf(ended.err), SizeIs(1));
    EXPECT_THAT(ended.err, HasSubstr("missing.obj"));
    EXPECT_FALSE(std::filesystem::exists(studio / "out"));
}

TEST(BadModel, FolderIsTold) {
    const Studio studio;
    std::filesystem::create_directory(studio / "folder.obj");
    const Ended ended = run(studio.turntableOf("folder.obj", 2));
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(linesOf(ended.err), SizeIs(1));
    EXPECT_THAT(ended.err, HasSubstr("folder.obj"));
}

TEST(BadModel, IsToldByInfoAsWell) {
    const Studio studio;
    Start start;
    start.folder = studio.path();
    start.arguments = {"info", "missing.obj"};
    const Ended ended = run(start);
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(ended.out, IsEmpty());
    EXPECT_THAT(linesOf(ended.err), SizeIs(1));
    EXPECT_THAT(ended.err, HasSubstr("missing.obj"));
}

TEST(BadModel, TrianglesThatAreWholeAreShownAllTheSame) {
    const Studio studio;
    writeFile(studio / "half.obj", "v 0 0 0\nv 1 0 0\nv 0 1 1\nv nan 0 0\nf 1 2 3\nf 1 2 4\n");
    const Ended ended = run(studio.turntableOf("half.obj", 1));
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
}

} // namespace
} // namespace quarn::test
