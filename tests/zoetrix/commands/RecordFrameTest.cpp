#include "tests/zoetrix/fixtures/RecordingFixture.h"
#include "zoetrix/commands/cmdZoetrix.h"

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

namespace {

class RecordFrames : public RecordingFixture {
protected:
    bool recordFrame(CQuarnView* drawn) {
        bool written = false;
        insideCommand([&](CQuarnDoc& document) {
            written = RecordFrame(document.RuntimeSerialNumber(), record(), drawn);
        });
        return written;
    }
    bool recordFrame() { return recordFrame(&view(L"Perspective")); }
    std::vector<std::wstring> images() {
        std::vector<std::wstring> names;
        for (const KM_wString& image : record().Images())
            names.emplace_back(image.View());
        return names;
    }
};

/// A window in which a person sees the views.
class SeeingFrontEnd final : public quarn::ScriptedFrontEnd {
public:
    void viewShown(CQuarnView&, const quarn::ShownPicture& picture) override {
        ++times_shown;
        seen.assign(picture.rgba.begin(), picture.rgba.end());
    }

    int times_shown = 0;
    std::vector<std::uint8_t> seen; ///< four bytes a pixel, from the top
};

/// Frames that are recorded before a person's eyes.
class SeenFrames : public RecordFrames {
protected:
    void SetUp() override {
        session.reset();
        session = std::make_unique<quarn::Session>(person, quarn::SessionOptions());
        ASSERT_TRUE(session->adoptProgramPlugIn().ok());
        RecordFrames::SetUp();
        person.times_shown = 0;
        person.seen.clear();
    }
    void TearDown() override { session.reset(); }

    SeeingFrontEnd person;
};

/// The pixels of a bitmap file as a view shows them.
std::vector<std::uint8_t> pixelsOf(const std::string& bmp, std::size_t width_px,
                                   std::size_t height_px) {
    constexpr std::size_t header_bytes = 54;
    const std::size_t row_bytes = 3 * width_px; // of no padding where the width is fourfold
    if (bmp.size() != header_bytes + row_bytes * height_px)
        return {};
    std::vector<std::uint8_t> rgba;
    for (std::size_t y = height_px; y-- > 0;)
        for (std::size_t x = 0; x < width_px; ++x) {
            const std::size_t blue = header_bytes + y * row_bytes + 3 * x;
            for (const std::size_t channel : {blue + 2, blue + 1, blue})
                rgba.push_back(static_cast<std::uint8_t>(bmp[channel]));
            rgba.push_back(255);
        }
    return rgba;
}

} // namespace

TEST_F(RecordFrames, FrameFiveOfWalkIsWalk005) {
    record().SetCurrentFrame(5);
    ASSERT_TRUE(recordFrame());
    EXPECT_THAT(files(), ElementsAre("Walk005.jpg"));
    EXPECT_THAT(images(), ElementsAre(L"Walk005.jpg"));
    EXPECT_TRUE(isJpeg(frames / "Walk005.jpg"));
}

TEST_F(RecordFrames, NumbersHaveAtLeastThreeDigits) {
    for (const int frame : {0, 7, 42, 999, 1000, 1234}) {
        record().SetCurrentFrame(frame);
        ASSERT_TRUE(recordFrame());
    }
    EXPECT_THAT(images(), ElementsAre(L"Walk000.jpg", L"Walk007.jpg", L"Walk042.jpg",
                                      L"Walk999.jpg", L"Walk1000.jpg", L"Walk1234.jpg"));
    EXPECT_EQ(6U, files().size());
}

TEST_F(RecordFrames, LeadingBlankOfTheNameIsKept) {
    record().SetHtmlFilename(L" Walk ");
    record().SetFileExtension(L"png");
    record().SetCurrentFrame(12);
    ASSERT_TRUE(recordFrame());
    EXPECT_THAT(files(), ElementsAre(" Walk 012.png"));
}

TEST_F(RecordFrames, NameIsNoFormatText) {
    record().SetHtmlFilename(L"%s%n%d");
    record().SetCurrentFrame(1);
    ASSERT_TRUE(recordFrame());
    EXPECT_THAT(files(), ElementsAre("%s%n%d001.jpg"));
}

TEST_F(RecordFrames, PictureHasTheViewsSizeAndCaptureSampling) {
    record().SetFileExtension(L"bmp");
    CQuarnDisplayPipeline* pipeline = view(L"Perspective").ActiveViewport().DisplayPipeline();
    ASSERT_NE(2, pipeline->CurrentDisplayAttributes()->m_antialiasing_level);
    ASSERT_TRUE(recordFrame());
    EXPECT_EQ(2, pipeline->CurrentDisplayAttributes()->m_antialiasing_level);
    const std::string bmp = readFile(frames / "Walk001.bmp");
    ASSERT_GT(bmp.size(), 26U);
    // Width and height stand at the bytes 18 and 22 of a bitmap file, little-endian.
    EXPECT_EQ(64, bmp[18]);
    EXPECT_EQ(48, std::abs(static_cast<signed char>(bmp[22])));
}

TEST_F(RecordFrames, FolderIsMadeWithThoseAboveIt) {
    record().SetFolderName(wide(frames / "a" / "b"));
    ASSERT_TRUE(recordFrame());
    EXPECT_TRUE(isJpeg(frames / "a" / "b" / "Walk001.jpg"));
}

TEST_F(RecordFrames, FolderThatCannotBeMadeFails) {
    writeFile(frames, "a file where the folder should be");
    EXPECT_FALSE(recordFrame());
    EXPECT_THAT(images(), IsEmpty());
    EXPECT_EQ("a file where the folder should be", readFile(frames));
    record().SetFolderName(L"");
    EXPECT_FALSE(recordFrame());
}

TEST_F(RecordFrames, NamesThatLeaveTheFolderAreNotWritten) {
    for (const wchar_t* name : {L"../Walk", L"a/b", L"a\\b", L"a\nb", L"\x01"}) {
        record().SetHtmlFilename(name);
        EXPECT_FALSE(recordFrame());
    }
    record().SetHtmlFilename(L"Walk");
    record().SetFileExtension(L"x/../../y.jpg");
    EXPECT_FALSE(recordFrame());
    EXPECT_THAT(images(), IsEmpty());
    EXPECT_FALSE(std::filesystem::exists(frames));
}

TEST_F(RecordFrames, UnknownExtensionIsNotWritten) {
    record().SetFileExtension(L"gif");
    EXPECT_FALSE(recordFrame());
    EXPECT_THAT(images(), IsEmpty());
    EXPECT_THAT(files(), IsEmpty());
}

TEST_F(RecordFrames, WithoutAViewOnlyTheRendererCanWrite) {
    EXPECT_FALSE(recordFrame(nullptr));
    EXPECT_THAT(files(), IsEmpty());
    renderSmall();
    record().SetRenderFull(true);
    EXPECT_TRUE(recordFrame(nullptr));
    EXPECT_THAT(files(), ElementsAre("Walk001.jpg"));
}

TEST_F(RecordFrames, FullRenderIsSavedAndItsWindowClosed) {
    renderSmall();
    record().SetRenderFull(true);
    record().SetRenderPreview(true);
    record().SetHtmlFilename(L"a walk");
    ASSERT_TRUE(recordFrame());
    EXPECT_EQ(L"Command: _Render\nCommand: _-SaveRenderWindowAs \"" +
                  std::wstring(wide(frames).View()) +
                  L"/a walk001.jpg\"\nCommand: _CloseRenderWindow\n",
              printed());
    EXPECT_TRUE(isJpeg(frames / "a walk001.jpg"));
    EXPECT_THAT(images(), ElementsAre(L"a walk001.jpg"));
    EXPECT_EQ(CQuarnCommand::failure, run(L"SaveRenderWindowAs x.jpg")) << "the window is closed";
}

TEST_F(RecordFrames, PreviewRenderIsSavedAndItsWindowClosed) {
    renderSmall();
    record().SetRenderPreview(true);
    ASSERT_TRUE(recordFrame());
    EXPECT_EQ(L"Command: _RenderPreview\nCommand: _-SaveRenderWindowAs \"" +
                  std::wstring(wide(frames).View()) +
                  L"/Walk001.jpg\"\nCommand: _CloseRenderWindow\n",
              printed());
    EXPECT_TRUE(isJpeg(frames / "Walk001.jpg"));
}

TEST_F(RecordFrames, RenderedPictureHasTheRenderSize) {
    renderSmall();
    record().SetRenderPreview(true);
    record().SetFileExtension(L"bmp");
    ASSERT_TRUE(recordFrame());
    // 24 bits a pixel behind 54 bytes of headers; the view is 64 by 48 pixels large.
    EXPECT_EQ(54U + 32U * 24U * 3U, readFile(frames / "Walk001.bmp").size());
}

TEST_F(RecordFrames, PathWithAQuoteNeverReachesAScript) {
    record().SetRenderFull(true);
    record().SetHtmlFilename(L"a\" _Exit \"");
    EXPECT_FALSE(recordFrame());
    EXPECT_EQ(L"", printed());
    record().SetHtmlFilename(L"Walk");
    record().SetFolderName(wide(frames) + L"\n_Exit");
    EXPECT_FALSE(recordFrame());
    EXPECT_EQ(L"", printed());
    EXPECT_FALSE(session->isExitRequested());
}

TEST_F(RecordFrames, QuoteInTheNameIsWrittenByTheDisplay) {
    record().SetHtmlFilename(L"a\"b");
    EXPECT_TRUE(recordFrame());
    EXPECT_THAT(files(), ElementsAre("a\"b001.jpg"));
}

TEST_F(RecordFrames, RenderThatIsCancelledWritesNothing) {
    renderSmall();
    front_end.setKeyDown(VK_ESCAPE, true);
    for (const bool full : {true, false}) {
        record().SetRenderFull(full);
        record().SetRenderPreview(!full);
        front_end.clearPrinted();
        EXPECT_FALSE(recordFrame());
        EXPECT_EQ(full ? L"Command: _Render\n" : L"Command: _RenderPreview\n", printed());
    }
    EXPECT_THAT(files(), IsEmpty());
    EXPECT_THAT(images(), IsEmpty());
}

TEST_F(RecordFrames, InterruptedProgramWritesNothing) {
    front_end.interrupt();
    EXPECT_FALSE(recordFrame());
    EXPECT_THAT(files(), IsEmpty());
}

TEST_F(SeenFrames, WhatIsRecordedIsAlsoWhatIsSeen) {
    record().SetFileExtension(L"bmp");
    for (const int frame : {1, 2}) {
        record().SetCurrentFrame(frame);
        placeCamera(L"Perspective", {4.0 * frame, -9.0, 3.0}, {0.0, 0.0, 1.0});
        ASSERT_TRUE(recordFrame());
        const std::string name = "Walk00" + std::to_string(frame) + ".bmp";
        const std::vector<std::uint8_t> recorded = pixelsOf(readFile(frames / name), 64, 48);
        ASSERT_FALSE(recorded.empty());
        EXPECT_TRUE(recorded == person.seen) << frame;
        EXPECT_EQ(frame, person.times_shown);
    }
}

TEST_F(SeenFrames, AViewThatIsRenderedIsDrawnAsWell) {
    renderSmall();
    for (const bool full : {true, false}) {
        record().SetRenderFull(full);
        record().SetRenderPreview(!full);
        person.times_shown = 0;
        ASSERT_TRUE(recordFrame());
        EXPECT_EQ(1, person.times_shown);
        EXPECT_EQ(4U * 64U * 48U, person.seen.size());
    }
}

TEST_F(SeenFrames, AViewWhoseRenderFailedIsDrawnAllTheSame) {
    renderSmall();
    person.setKeyDown(VK_ESCAPE, true);
    for (const bool full : {true, false}) {
        record().SetRenderFull(full);
        record().SetRenderPreview(!full);
        person.times_shown = 0;
        EXPECT_FALSE(recordFrame());
        EXPECT_EQ(1, person.times_shown);
    }
    EXPECT_THAT(images(), IsEmpty());
}
