#include "tests/quarn/Pictures.h"
#include "tests/quarn/Studio.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;

TEST(Languages, AChineseScriptRecordsAChineseTurntable) {
    const Studio studio;
    std::filesystem::create_directory(studio / "录制");
    writeFile(studio / "步骤.txt", "StandardView 透视图\n"
                                   "ViewportSize 64 48\n"
                                   "FitView 旋转=否 _Enter\n"
                                   "SetTurntableAnimation 2 逆时针 png [着色] _Enter _Enter\n"
                                   "AnimationName 旋转的房子\n"
                                   "RecordAnimation 目标文件夹 \"录制\" 播放动画=否 _Enter\n");
    Start start;
    start.folder = studio.path();
    start.arguments = {"run", "步骤.txt", "house.obj", "--language", "zh_CN.UTF-8"};
    const Ended ended = run(start);
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(filesIn(studio / "录制"),
                ElementsAre("旋转的房子.frames.json", "旋转的房子.html", "旋转的房子.recording",
                            "旋转的房子000.png", "旋转的房子001.png"));
    const std::string page = readFile(studio / "录制/旋转的房子.html");
    for (const char* text : {"<TITLE>旋转的房子</TITLE>", "停止", "开始", "循环播放", "显示帧计数"})
        EXPECT_THAT(page, HasSubstr(text));
}

} // namespace
} // namespace quarn::test
