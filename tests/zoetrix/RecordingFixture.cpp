#include "tests/zoetrix/RecordingFixture.h"

#include <algorithm>

void RecordingFixture::SetUp() {
    importObj("v -1 -1 0\nv 1 -1 0\nv 1 1 0\nv -1 1 0\nv 0 0 2\no roof\n"
              "f 1 2 5\nf 2 3 5\nf 3 4 5\nf 4 1 5\n");
    ASSERT_EQ(CQuarnCommand::success, run(L"ViewportSize 64 48"));
    setUpCameraFrames(3);
    record().SetDisplayMode(CQuarnDisplayAttrsMgr::RenderedModeId());
    record().SetFolderName(wide(frames));
    front_end.clearPrinted();
}

void RecordingFixture::renderSmall() {
    ASSERT_EQ(CQuarnCommand::success,
              run(L"RenderSettings Size 32 24 Samples 8 PreviewSamples 1 _Enter"));
    front_end.clearPrinted();
}

std::vector<std::string> RecordingFixture::files() const {
    std::vector<std::string> names;
    std::error_code error;
    for (const auto& entry : std::filesystem::directory_iterator(frames, error))
        names.push_back(entry.path().filename().string());
    std::ranges::sort(names);
    return names;
}
