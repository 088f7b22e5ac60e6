#include "engine/images/ImageFile.h"

#include "tests/support/TempFolder.h"

#include <cmath>
#include <csignal>
#include <fstream>
#include <gmock/gmock.h>
#include <iterator>
#include <spng.h>
#include <sys/resource.h>
#include <turbojpeg.h>

namespace quarn::test {
namespace {

namespace fs = std::filesystem;
using ::testing::HasSubstr;

std::vector<std::uint8_t> bytesOf(const fs::path& path) {
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
}

/// Red grows to the right, green downward.
Image ramp(int width, int height) {
    Image image;
    image.resize(width, height);
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x) {
            std::uint8_t* pixel = &image.rgba[4 * static_cast<std::size_t>(y * width + x)];
            pixel[0] = static_cast<std::uint8_t>(255 * x / width);
            pixel[1] = static_cast<std::uint8_t>(255 * y / height);
            pixel[2] = 77;
            pixel[3] = 255;
        }
    }
    return image;
}

std::size_t fileCount(const fs::path& folder) {
    return static_cast<std::size_t>(
        std::distance(fs::directory_iterator(folder), fs::directory_iterator()));
}

TEST(ImageFile, PngComesBackPixelByPixel) {
    const TempFolder folder;
    const Image image = ramp(37, 21);
    const fs::path path = folder.path() / "a.png";
    ASSERT_TRUE(writeImageFile(path, image).ok());
    const auto bytes = bytesOf(path);
    spng_ctx* context = spng_ctx_new(0);
    spng_set_png_buffer(context, bytes.data(), bytes.size());
    spng_ihdr header{};
    ASSERT_EQ(spng_get_ihdr(context, &header), 0);
    EXPECT_EQ(header.width, 37U);
    EXPECT_EQ(header.height, 21U);
    EXPECT_EQ(header.color_type, SPNG_COLOR_TYPE_TRUECOLOR);
    std::vector<std::uint8_t> rgb(3U * 37 * 21);
    ASSERT_EQ(spng_decode_image(context, rgb.data(), rgb.size(), SPNG_FMT_RGB8, 0), 0);
    spng_ctx_free(context);
    for (std::size_t i = 0; i < 37U * 21; ++i) {
        ASSERT_EQ(rgb[3 * i], image.rgba[4 * i]);
        ASSERT_EQ(rgb[3 * i + 1], image.rgba[4 * i + 1]);
        ASSERT_EQ(rgb[3 * i + 2], image.rgba[4 * i + 2]);
    }
}

TEST(ImageFile, PngOfASeeThroughPictureKeepsItsOpacity) {
    Image image = ramp(9, 5);
    for (std::size_t i = 3; i < image.rgba.size(); i += 4)
        image.rgba[i] = static_cast<std::uint8_t>(i);
    const TempFolder folder;
    ASSERT_TRUE(writeImageFile(folder.path() / "a.png", image).ok());
    const auto bytes = bytesOf(folder.path() / "a.png");
    spng_ctx* context = spng_ctx_new(0);
    spng_set_png_buffer(context, bytes.data(), bytes.size());
    spng_ihdr header{};
    ASSERT_EQ(spng_get_ihdr(context, &header), 0);
    EXPECT_EQ(header.color_type, SPNG_COLOR_TYPE_TRUECOLOR_ALPHA);
    std::vector<std::uint8_t> rgba(image.rgba.size());
    ASSERT_EQ(spng_decode_image(context, rgba.data(), rgba.size(), SPNG_FMT_RGBA8, 0), 0);
    spng_ctx_free(context);
    EXPECT_EQ(rgba, image.rgba);
}

TEST(ImageFile, JpegHasFullColourResolutionAndComesBackClose) {
    const TempFolder folder;
    const Image image = ramp(64, 48);
    const fs::path path = folder.path() / "a.jpg";
    ASSERT_TRUE(writeImageFile(path, image).ok());
    const auto bytes = bytesOf(path);
    tjhandle decoder = tjInitDecompress();
    int width = 0;
    int height = 0;
    int subsampling = 0;
    int colors = 0;
    ASSERT_EQ(tjDecompressHeader3(decoder, bytes.data(), bytes.size(), &width, &height,
                                  &subsampling, &colors),
              0);
    EXPECT_EQ(width, 64);
    EXPECT_EQ(height, 48);
    EXPECT_EQ(subsampling, TJSAMP_444);
    std::vector<std::uint8_t> rgba(4U * 64 * 48);
    ASSERT_EQ(tjDecompress2(decoder, bytes.data(), bytes.size(), rgba.data(), 64, 0, 48, TJPF_RGBX,
                            TJFLAG_ACCURATEDCT),
              0);
    tjDestroy(decoder);
    double difference = 0.0;
    for (std::size_t i = 0; i < rgba.size(); i += 4) {
        for (std::size_t c = 0; c < 3; ++c) {
            difference += std::abs(rgba[i + c] - image.rgba[i + c]);
        }
    }
    EXPECT_LT(difference / (3.0 * 64 * 48), 2.0);
}

TEST(ImageFile, BmpHoldsBlueGreenRedFromTheBottomInPaddedRows) {
    Image image;
    image.resize(1, 2);
    image.rgba = {10, 20, 30, 0, 40, 50, 60, 255};
    const TempFolder folder;
    ASSERT_TRUE(writeImageFile(folder.path() / "a.bmp", image).ok());
    const std::vector<std::uint8_t> expected{'B', 'M', 62,   0,    0,  0,  0,    0,    0, 0, 54,
                                             0,   0,   0, // 54 + 2 rows of 4
                                             40,  0,   0,    0,    1,  0,  0,    0,    2, 0, 0,
                                             0,   1,   0,    24,   0,  0,  0,    0,    0, 8, 0,
                                             0,   0,   0xC4, 0x0E, 0,  0,  0xC4, 0x0E, 0, 0, 0,
                                             0,   0,   0,    0,    0,  0,  0, // 3780 a metre
                                             60,  50,  40,   0,    30, 20, 10,   0};
    EXPECT_EQ(bytesOf(folder.path() / "a.bmp"), expected);
}

TEST(ImageFile, TgaOfASeeThroughPictureHoldsItsOpacityBehindTheColours) {
    Image image;
    image.resize(1, 2);
    image.rgba = {10, 20, 30, 0, 40, 50, 60, 255};
    const TempFolder folder;
    ASSERT_TRUE(writeImageFile(folder.path() / "a.tga", image).ok());
    const std::vector<std::uint8_t> expected{0, 0, 2, 0,  0, 0,  0,  0,  0,   0,  0,  0,  1,
                                             0, 2, 0, 32, 8, 60, 50, 40, 255, 30, 20, 10, 0};
    EXPECT_EQ(bytesOf(folder.path() / "a.tga"), expected);
}

TEST(ImageFile, TgaHoldsBlueGreenRedFromTheBottom) {
    Image image;
    image.resize(1, 2);
    image.rgba = {10, 20, 30, 255, 40, 50, 60, 255};
    const TempFolder folder;
    ASSERT_TRUE(writeImageFile(folder.path() / "a.tga", image).ok());
    const std::vector<std::uint8_t> expected{0, 0, 2, 0, 0,  0, 0,  0,  0,  0,  0,  0,
                                             1, 0, 2, 0, 24, 0, 60, 50, 40, 30, 20, 10};
    EXPECT_EQ(bytesOf(folder.path() / "a.tga"), expected);
}

TEST(ImageFile, ExtensionsCountWhateverTheirCase) {
    const TempFolder folder;
    for (const char* name : {"a.JPG", "a.jpeg", "a.Png", "a.BMP", "a.tGa"}) {
        EXPECT_TRUE(writeImageFile(folder.path() / name, ramp(8, 8)).ok()) << name;
        EXPECT_GT(fs::file_size(folder.path() / name), 0U);
    }
    EXPECT_EQ(imageFormatFor("JPEG"), ImageFormat::jpeg);
    EXPECT_EQ(imageFormatFor(".tga"), ImageFormat::tga);
    EXPECT_EQ(imageFormatFor("tiff"), std::nullopt);
    EXPECT_EQ(imageFormatFor(""), std::nullopt);
}

TEST(ImageFile, UnknownExtensionIsAnErrorThatListsTheKnown) {
    const TempFolder folder;
    const auto written = writeImageFile(folder.path() / "a.webp", ramp(8, 8));
    ASSERT_FALSE(written.ok());
    EXPECT_THAT(written.message(), HasSubstr("Choose jpg, png, bmp or tga."));
    EXPECT_EQ(fileCount(folder.path()), 0U);
}

TEST(ImageFile, MissingFolderIsAnErrorThatNamesTheFile) {
    const TempFolder folder;
    const auto written = writeImageFile(folder.path() / "gone" / "a.png", ramp(8, 8));
    ASSERT_FALSE(written.ok());
    EXPECT_THAT(written.message(), HasSubstr("a.png': its folder does not exist."));
}

TEST(ImageFile, FolderOfThatNameIsNotReplaced) {
    const TempFolder folder;
    fs::create_directory(folder.path() / "a.png");
    const auto written = writeImageFile(folder.path() / "a.png", ramp(8, 8));
    ASSERT_FALSE(written.ok());
    EXPECT_THAT(written.message(), HasSubstr("there is a folder of this name"));
    EXPECT_TRUE(fs::is_directory(folder.path() / "a.png"));
}

TEST(ImageFile, PictureThatDoesNotFitItsPixelsIsRefused) {
    const std::vector<std::uint8_t> few(12);
    EXPECT_FALSE(encodeImage(ImageView(2, 2, few), ImageFormat::png).ok());
    EXPECT_FALSE(encodeImage(ImageView(0, 0, {}), ImageFormat::jpeg).ok());
    EXPECT_FALSE(encodeImage(ImageView(-1, -3, few), ImageFormat::bmp).ok());
}

/// Lets no file grow past a size while it lives, as a full disk would.
class FileSizeLimit {
public:
    explicit FileSizeLimit(rlim_t bytes) {
        m_signal = std::signal(SIGXFSZ, SIG_IGN);
        getrlimit(RLIMIT_FSIZE, &m_before);
        rlimit limit = m_before;
        limit.rlim_cur = bytes;
        setrlimit(RLIMIT_FSIZE, &limit);
    }
    ~FileSizeLimit() {
        setrlimit(RLIMIT_FSIZE, &m_before);
        std::signal(SIGXFSZ, m_signal);
    }
    FileSizeLimit(const FileSizeLimit&) = delete;
    FileSizeLimit& operator=(const FileSizeLimit&) = delete;

private:
    rlimit m_before{};
    void (*m_signal)(int) = nullptr;
};

TEST(ImageFile, FailedWriteLeavesNoFileAndKeepsTheOldOne) {
    const TempFolder folder;
    const fs::path old = folder / "old.bmp";
    writeFile(old, "what was there");
    {
        const FileSizeLimit limit(1000);
        EXPECT_FALSE(writeImageFile(old, ramp(64, 64)).ok());
        EXPECT_FALSE(writeImageFile(folder.path() / "new.bmp", ramp(64, 64)).ok());
    }
    EXPECT_EQ(fileCount(folder.path()), 1U);
    EXPECT_EQ(bytesOf(old).size(), std::string("what was there").size());
}

} // namespace
} // namespace quarn::test
