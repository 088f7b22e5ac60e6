// Input that a modeller would not make on purpose, through the whole program, in every display
// mode.
#include "tests/quarn/Pictures.h"
#include "tests/quarn/models/CaptureWays.h"
#include "tests/quarn/models/PlacedHouse.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sstream>

namespace quarn::test {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::SizeIs;

constexpr const char* MODES[] = {"Wireframe", "Shaded",  "Rendered", "Translucent",
                                 "X-Ray",     "Drawing", "Clay"};

class BadInput : public testing::TestWithParam<const char*> {
protected:
    /// Records two frames of a model.
    std::vector<Picture> record(const std::string& model, const std::string& size = "160x100") {
        const std::string folder = "out-" + model.substr(0, model.find('.'));
        const Ended ended = run(m_studio.turntableOf(model, 2,
                                                     {"--mode", GetParam(), "--light", "sky",
                                                      "--format", "bmp", "--size", size, "--out",
                                                      folder})); // whatever the size of the model
        EXPECT_EQ(ended.exit_code, 0) << ended.err;
        m_told = ended.err;
        std::vector<Picture> pictures;
        for (const std::string& file : filesIn(m_studio / folder))
            if (file.ends_with(".bmp"))
                pictures.push_back(readBitmap(m_studio / folder / file));
        return pictures;
    }

    void expectSamePictures(const std::string& model, double tolerance) {
        const std::vector<Picture> expected = record("house.obj");
        const std::vector<Picture> pictures = record(model);
        ASSERT_THAT(expected, SizeIs(2));
        ASSERT_THAT(pictures, SizeIs(2));
        for (std::size_t i = 0; i < 2; ++i)
            EXPECT_LE(meanDifference(expected[i], pictures[i]), tolerance) << model << i;
    }

    Studio m_studio;
    std::string m_told; ///< by the last recording, on the standard error
};

TEST_P(BadInput, TrianglesThatCannotBeDrawnLeaveTheOthersAsTheyAre) {
    const std::string house = readFile(m_studio / "house.obj");
    writeFile(m_studio / "nan.obj",
              house + "v nan 0 0\nv 0 inf 0\nv 0 0 -inf\nf 1 2 -1\nf -3 -2 -1\nf -3 1 2\n");
    expectSamePictures("nan.obj", 0.0);
    EXPECT_THAT(linesOf(m_told), SizeIs(1));
    EXPECT_THAT(m_told, HasSubstr("3 of 27 triangles were left out"));
}

TEST_P(BadInput, TrianglesWithoutAreaLeaveTheOthersAsTheyAre) {
    const std::string house = readFile(m_studio / "house.obj");
    writeFile(m_studio / "slivers.obj", house + "f 1 1 1\nf 1 1 2\nf 1 2 1\n");
    expectSamePictures("slivers.obj", 0.0);
    EXPECT_THAT(m_told, IsEmpty());
}

TEST_P(BadInput, MeshWithoutAreaIsToldAndRecordedAllTheSame) {
    writeFile(m_studio / "flat.obj", "v 0 0 0\nv 1 1 1\nv 2 2 2\nf 1 2 3\nf 1 1 2\n");
    EXPECT_THAT(record("flat.obj"), SizeIs(2));
    EXPECT_THAT(linesOf(m_told), SizeIs(1));
    EXPECT_THAT(m_told, HasSubstr("flat.obj"));
    EXPECT_THAT(m_told, HasSubstr("no area"));
}

TEST_P(BadInput, FileWithoutTrianglesShowsItsPoints) {
    writeFile(m_studio / "cloud.obj", "v 0 0 0\nv 1 1 1\nv 2 0 2\n");
    const std::vector<Picture> pictures = record("cloud.obj");
    ASSERT_THAT(pictures, SizeIs(2));
    EXPECT_THAT(m_told, IsEmpty());
}

TEST_P(BadInput, SurveyCoordinatesDoNotJitter) {
    writePlacedHouse(m_studio, "far.obj", 1.0, {1e7, 0.5e7, 0.0});
    expectSamePictures("far.obj", 1e-4);
    writePlacedHouse(m_studio, "farther.obj", 1.0, {1e9, 0.5e9, 0.0});
    expectSamePictures("farther.obj", 1e-3);
}

TEST_P(BadInput, AModelOfAThousandKilometresLooksAsItDoesAtItsSize) {
    writePlacedHouse(m_studio, "province.obj", 0.25e6, {});
    expectSamePictures("province.obj", 1e-3);
}

TEST_P(BadInput, PicturesOfOnePixelOrOneLineAreWritten) {
    for (const auto& [size, width, height] :
         {std::tuple("1x1", 1, 1), std::tuple("1x2000", 1, 2000), std::tuple("2000x1", 2000, 1)}) {
        const std::vector<Picture> pictures = record("house.obj", size);
        ASSERT_THAT(pictures, SizeIs(2)) << size;
        for (const Picture& picture : pictures) {
            EXPECT_EQ(picture.width_px, width);
            EXPECT_EQ(picture.height_px, height);
        }
        EXPECT_THAT(m_told, IsEmpty());
    }
}

INSTANTIATE_TEST_SUITE_P(Mode, BadInput, testing::ValuesIn(MODES), nameOfWay);

class BadTexture : public testing::TestWithParam<std::pair<const char*, std::string>> {};

std::string bigEndian32(std::uint32_t value) {
    std::string bytes;
    for (int shift = 24; shift >= 0; shift -= 8)
        bytes += static_cast<char>(value >> shift & 0xFF);
    return bytes;
}

/// The first bytes of a PNG of that size; its pixels are missing, and its check sums wrong.
std::string pngOf(std::uint32_t width, std::uint32_t height) {
    return "\x89PNG\r\n\x1A\n" + bigEndian32(13) + "IHDR" + bigEndian32(width) +
           bigEndian32(height) + std::string("\x08\x06\0\0\0", 5) + std::string(8, 'x');
}

TEST_P(BadTexture, IsToldOnceAndTheModelIsDrawnWithoutIt) {
    const Studio studio;
    const auto& [reason, bytes] = GetParam();
    if (!bytes.empty())
        writeFile(studio / "brick.png", bytes);
    std::string painted = "mtllib house.mtl\nvt 0 0\nusemtl brick\n";
    std::istringstream house(readFile(studio / "house.obj"));
    for (std::string line; std::getline(house, line);) {
        std::istringstream words(line);
        std::string word;
        words >> word;
        if (word == "f") {
            painted += "f";
            for (std::string corner; words >> corner;)
                painted += " " + corner.substr(0, corner.find('/')) + "/1";
            painted += "\n";
        } else if (word == "v" || word == "o") {
            painted += line + "\n";
        }
    }
    writeFile(studio / "painted.obj", painted);
    writeFile(studio / "house.mtl", "newmtl brick\nKd 0.8 0.2 0.1\nmap_Kd brick.png\n");
    std::filesystem::create_directory(studio / "plain");
    writeFile(studio / "plain/painted.obj", painted);
    writeFile(studio / "plain/house.mtl", "newmtl brick\nKd 0.8 0.2 0.1\n");
    for (const char* const mode : MODES) {
        const std::vector<std::string> options = {"--mode", mode, "--format", "bmp"};
        std::vector<std::string> textured = options;
        textured.insert(textured.end(), {"--out", "textured"});
        std::vector<std::string> plain = options;
        plain.insert(plain.end(), {"--out", "untextured"});
        const Ended ended = run(studio.turntableOf("painted.obj", 1, textured));
        EXPECT_EQ(ended.exit_code, 0) << ended.err;
        EXPECT_THAT(linesOf(ended.err), SizeIs(1)) << ended.err;
        EXPECT_THAT(ended.err, HasSubstr("The texture 'brick.png' was left out: "));
        EXPECT_THAT(ended.err, HasSubstr(reason));
        ASSERT_EQ(run(studio.turntableOf("plain/painted.obj", 1, plain)).err, "");
        const Picture picture = readBitmap(studio / "textured/painted000.bmp");
        ASSERT_EQ(picture.width_px, 64);
        EXPECT_EQ(picture.bytes, readBitmap(studio / "untextured/painted000.bmp").bytes) << mode;
    }
}

INSTANTIATE_TEST_SUITE_P(
    Kind, BadTexture,
    testing::Values(std::pair("there is no such file", std::string()),
                    std::pair("not a picture of a known kind", std::string("not a picture at all")),
                    std::pair("the picture is damaged", pngOf(64, 64)),
                    std::pair("too large", pngOf(16000, 16000)),
                    std::pair("too large", pngOf(2'000'000'000, 2'000'000'000))));

TEST(BadFileName, OfAnyKindIsReadOrRefusedWithAMessage) {
    const Studio studio;
    const std::string house = readFile(studio / "house.obj");
    const auto record = [&](const std::string& name) {
        writeFile(studio / name, house);
        return run(studio.turntableOf(name, 1, {"--out", "out"}));
    };
    for (const char* const name :
         {"it's a house.obj", "дом 家 🏠.obj", "-house.obj", "100% $HOME `ls`.obj", "a&b;c.obj"}) {
        const Ended ended = record(std::string("./") + name);
        EXPECT_EQ(ended.exit_code, 0) << name << ended.err;
        EXPECT_THAT(ended.err, IsEmpty());
    }
    for (const char* const name : {"a \"quoted\" house.obj", "two\nlines.obj"}) {
        const Ended ended = record(name);
        EXPECT_NE(ended.exit_code, 0) << name;
        EXPECT_EQ(ended.killed_by, 0);
        EXPECT_THAT(ended.err, HasSubstr("path"));
    }
    const Ended too_long = run(studio.turntableOf(std::string(300, 'n') + ".obj", 1));
    EXPECT_NE(too_long.exit_code, 0);
    EXPECT_EQ(too_long.killed_by, 0);
    EXPECT_THAT(too_long.err, HasSubstr("nnn.obj"));
    const std::string longest = std::string(251, 'n') + ".obj"; // 255 bytes, what a folder takes
    const Ended just_fits = record(longest);
    EXPECT_EQ(just_fits.killed_by, 0);
    EXPECT_THAT(just_fits.exit_code == 0 ? std::string() : just_fits.err,
                testing::AnyOf(IsEmpty(), HasSubstr("name")));
}

TEST(BadFile, TextWithTheExtensionOfAModelIsRefused) {
    const Studio studio;
    for (const char* const extension :
         {"obj", "ply", "stl", "glb", "gltf", "fbx", "dae", "3ds", "3mf", "off", "dxf", "blend"}) {
        const std::string name = std::string("letter.") + extension;
        writeFile(studio / name, "Dear Sir,\nplease find enclosed what you asked for.\n");
        const Ended ended = run(studio.turntableOf(name, 1));
        EXPECT_EQ(ended.exit_code, 1) << name;
        EXPECT_THAT(linesOf(ended.err), SizeIs(1)) << ended.err;
        EXPECT_THAT(ended.err, HasSubstr(name));
        EXPECT_FALSE(std::filesystem::exists(studio / "out"));
    }
}

TEST(BadFile, ThatMayNotBeReadIsRefused) {
    const Studio studio;
    std::filesystem::permissions(studio / "house.obj", std::filesystem::perms::none);
    const Ended ended = run(studio.turntable(1));
    if (geteuid() == 0) {
        EXPECT_EQ(ended.exit_code, 0); // who may read anything
        return;
    }
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(ended.err, HasSubstr("house.obj"));
}

} // namespace
} // namespace quarn::test
