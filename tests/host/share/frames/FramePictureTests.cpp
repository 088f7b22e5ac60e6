#include "host/share/frames/FramePicture.h"
#include "tests/host/share/viewer/RecordedFrames.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using testing::AllOf;
using testing::HasSubstr;

TEST(FramePicture, IsReadBackInEveryFormatThatIsRecorded) {
    for (const char* extension : {"jpg", "png", "bmp", "tga"}) {
        const RecordedFrames frames(1, extension);
        ASSERT_TRUE(writeImageFile(frames.file(0), plainPicture(63, 35, 200)));
        const auto picture = readFramePicture(frames.file(0));
        ASSERT_TRUE(picture) << picture.message();
        EXPECT_EQ(picture.value().width, 63);
        EXPECT_EQ(picture.value().height, 35);
        EXPECT_NEAR(picture.value().pixel(62, 34)[0], 200, 2) << extension;
        EXPECT_EQ(picture.value().pixel(62, 34)[3], 255) << extension;
    }
}

TEST(FramePicture, ThatCannotBeReadIsNamedWithTheReason) {
    const RecordedFrames frames(1);
    const auto whyNotRead = [&](int frame) { return whyNot(readFramePicture(frames.file(frame))); };
    EXPECT_THAT(whyNotRead(7), HasSubstr("House007.jpg"));
    frames.cut(0);
    EXPECT_THAT(whyNotRead(0), AllOf(HasSubstr("House000.jpg"), HasSubstr("cut off")));
    writeFile(frames.file(0), "");
    EXPECT_THAT(whyNotRead(0), HasSubstr("empty"));
    writeFile(frames.file(0), "This is a text and no picture.");
    EXPECT_THAT(whyNotRead(0), HasSubstr("not a picture of a known kind"));
}

} // namespace
} // namespace quarn::test
