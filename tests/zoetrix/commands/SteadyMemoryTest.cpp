#include "tests/support/AllocationCount.h"
#include "tests/zoetrix/fixtures/RecordingFixture.h"

#include <cmath>
#include <cstdlib>
#include <unistd.h>

namespace {

using Record = KM_3dmAnimationProperties;

/// A bumpy ground of 2 * 40 * 40 triangles with a name.
std::string groundObj() {
    std::string text;
    for (int y = 0; y <= 40; ++y)
        for (int x = 0; x <= 40; ++x)
            text += "v " + std::to_string(x - 20) + " " + std::to_string(y) + " " +
                    std::to_string(0.5 * std::sin(0.7 * x) * std::cos(0.5 * y)) + "\n";
    text += "o ground\n";
    for (int y = 0; y < 40; ++y)
        for (int x = 1; x <= 40; ++x) {
            const int a = 41 * y + x;
            text += "f " + std::to_string(a) + " " + std::to_string(a + 1) + " " +
                    std::to_string(a + 42) + " " + std::to_string(a + 41) + "\n";
        }
    return text;
}

/// What the library of a format asks for itself in each picture, and gives back at its end: rows
/// and tables. Its interface offers no way to keep them.
std::size_t askedByTheLibraryOf(const std::wstring& format) {
    if (format == L"jpg")
        return 9;
    return format == L"png" ? 11 : 0;
}

/// Recordings of 24 frames with a view of 160 by 100 pixels.
class SteadyRecording : public RecordingFixture {
protected:
    static constexpr int frame_count = 24;

    void SetUp() override {
        RecordingFixture::SetUp();
        importObj(groundObj());
        ASSERT_EQ(CQuarnCommand::success, run(L"ViewportSize 160 100"));
        setUpCameraFrames(frame_count);
    }

    /// Records what is set up.
    /// @return for each frame what the whole program asked the heap for until all of it was done
    std::vector<std::size_t> requestsOfFrames(const std::wstring& format) {
        record().SetFolderName(wide(frames));
        record().SetFileExtension(format.c_str());
        std::vector<std::string> files;
        for (int k = 0; k < frame_count; ++k)
            files.push_back(frames /
                            KM_wString::FormatToString(L"Walk%03d.%s", k, format.c_str()).ToUtf8());
        std::vector<std::size_t> counts;
        counts.reserve(files.size());
        front_end.while_waiting = [&] {
            const std::size_t count = AllocationCount::now().all();
            if (counts.size() < files.size() && access(files[counts.size()].c_str(), F_OK) == 0)
                counts.push_back(count);
        };
        EXPECT_EQ(CQuarnCommand::success, run(L"RecordAnimation _Enter"));
        front_end.while_waiting = nullptr;
        for (std::size_t k = counts.size(); k-- > 1;)
            counts[k] -= counts[k - 1];
        return counts;
    }

    /// Each frame's name is kept for the page, in a list that grows now and then.
    void expectNamesAlone(const std::wstring& format) {
        const std::vector<std::size_t> requests = requestsOfFrames(format);
        ASSERT_EQ(requests.size(), static_cast<std::size_t>(frame_count));
        std::size_t growths = 0;
        for (std::size_t k = 3; k <= 20; ++k) {
            const std::size_t others = askedByTheLibraryOf(format) + 1;
            EXPECT_LE(requests[k], others + 1) << "in frame " << k;
            growths += requests[k] > others ? 1 : 0;
        }
        EXPECT_LE(growths, 3U);
    }
};

class SteadyRecordingInFormat : public SteadyRecording,
                                public testing::WithParamInterface<const wchar_t*> {};
class SteadyRecordingInMode : public SteadyRecording,
                              public testing::WithParamInterface<const wchar_t*> {};

} // namespace

TEST_P(SteadyRecordingInFormat, FramesAskForTheirNamesAlone) {
    record().SetDisplayMode(CQuarnDisplayAttrsMgr::RenderedModeId());
    expectNamesAlone(GetParam());
}

TEST_P(SteadyRecordingInMode, FramesAskForTheirNamesAlone) {
    KM_SimpleArray<const CDisplayPipelineAttributes*> modes;
    CQuarnDisplayAttrsMgr::GetDisplayAttrsList(modes);
    for (const CDisplayPipelineAttributes* mode : modes)
        if (mode->EnglishName() == GetParam())
            record().SetDisplayMode(mode->Id());
    expectNamesAlone(L"bmp");
}

TEST_F(SteadyRecording, FramesOfAFlythroughAskForTheirNamesAlone) {
    record().SetCaptureType(Record::flythrough);
    expectNamesAlone(L"tga");
}

TEST_F(SteadyRecording, FramesOfADayOfSunAskForTheirNamesAlone) {
    setUpSunFrames(frame_count);
    expectNamesAlone(L"bmp");
}

TEST_F(SteadyRecording, SecondRecordingHoldsNoMoreMemoryThanTheFirst) {
    requestsOfFrames(L"jpg");
    const std::size_t after_one = AllocationCount::now().held_bytes;
    requestsOfFrames(L"jpg");
    const std::size_t after_two = AllocationCount::now().held_bytes;
    EXPECT_LE(after_two, after_one + 4096);
}

INSTANTIATE_TEST_SUITE_P(Formats, SteadyRecordingInFormat,
                         testing::Values(L"jpg", L"png", L"bmp", L"tga"),
                         [](const auto& format) { return KM_wString(format.param).ToUtf8(); });

INSTANTIATE_TEST_SUITE_P(Modes, SteadyRecordingInMode,
                         testing::Values(L"Wireframe", L"Shaded", L"Rendered", L"Translucent",
                                         L"X-Ray", L"Drawing", L"Clay"),
                         [](const auto& mode) {
                             KM_wString name(mode.param);
                             name.Remove(L'-');
                             return name.ToUtf8();
                         });

TEST(AllocationCounter, CountsWhatTheProgramAsksFor) {
    const AllocationCount before = AllocationCount::now();
    const std::string text(10000, 'x');
    const std::vector<int> numbers(10, 7);
    void* volatile by_c = std::malloc(20); // or the compiler leaves it out
    const AllocationCount after = AllocationCount::now();
    std::free(by_c);
    EXPECT_EQ(1U, after.large - before.large);
    EXPECT_EQ(2U, after.small - before.small);
    EXPECT_GE(after.held_bytes - before.held_bytes, 10060U);
    EXPECT_EQ(10007U, text.size() + static_cast<std::size_t>(numbers[3]));
}
