#include "host/share/viewer/PageTexts.h"
#include "host/share/viewer/ViewerPage.h"
#include "tests/host/app/TestCommand.h"
#include "tests/host/share/viewer/RecordedFrames.h"

#include <csignal>
#include <gmock/gmock.h>
#include <nlohmann/json.hpp>
#include <regex>
#include <sys/resource.h>

namespace quarn::test {
namespace {

using testing::AllOf;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;
using testing::StartsWith;
using Json = nlohmann::json;

const std::filesystem::path SOURCES = QUARN_SOURCE_DIR;

class ViewerPageTest : public HostTest {
protected:
    Result<WrittenPage> write(const RecordedFrames& frames, bool is_one_file = false,
                              const std::string& title = "") {
        return writeViewerPage(frames.read(), {is_one_file, title}, m_sources);
    }
    static Json recordingIn(const std::filesystem::path& page) {
        const std::string text = readFile(page);
        const std::string begin = "id=\"recording\">";
        const std::size_t at = text.find(begin) + begin.size();
        return Json::parse(text.substr(at, text.find("</script>", at) - at));
    }
    static std::size_t count(const std::string& text, const std::string& part) {
        std::size_t found = 0;
        for (std::size_t at = text.find(part); at != text.npos; at = text.find(part, at + 1))
            ++found;
        return found;
    }

    PageSources m_sources{SOURCES / "share/viewer", {SOURCES / "host/locale"}};
};

TEST_F(ViewerPageTest, ThatIsNotWantedAnyMoreLeavesTheEarlierOneAlone) {
    const RecordedFrames frames(3);
    ASSERT_TRUE(write(frames));
    const std::string earlier = readFile(frames.page());
    std::vector<double> shares;
    const auto page = writeViewerPage(frames.read(), {true, ""}, m_sources, [&](double share) {
        shares.push_back(share);
        return shares.size() < 2;
    });
    ASSERT_FALSE(page);
    EXPECT_THAT(page.message(), HasSubstr("is not written: it was given up."));
    EXPECT_THAT(shares, ElementsAre(0.0, testing::DoubleEq(1.0 / 3)));
    EXPECT_EQ(readFile(frames.page()), earlier);
}

TEST_F(ViewerPageTest, NamesThePicturesBesideIt) {
    const RecordedFrames frames(3);
    const auto page = write(frames);
    ASSERT_TRUE(page) << page.message();
    EXPECT_EQ(page.value().file, frames.page());
    EXPECT_EQ(page.value().pictures, 3);
    EXPECT_EQ(page.value().bytes, std::filesystem::file_size(frames.page()));
    const Json json = recordingIn(frames.page());
    EXPECT_EQ(json["files"], Json::parse(R"(["House000.jpg", "House001.jpg", "House002.jpg"])"));
    EXPECT_EQ(json["width"], 64);
    EXPECT_EQ(json["height"], 36);
    EXPECT_THAT(readFile(frames.page()), HasSubstr("src=\"House000.jpg\""));
    EXPECT_THAT(readFile(frames.page()), Not(HasSubstr("{{")));
}

TEST_F(ViewerPageTest, CarriesEachPictureOnceAsItWasRecorded) {
    const RecordedFrames frames(3);
    const auto page = write(frames, true);
    ASSERT_TRUE(page) << page.message();
    const std::string text = readFile(frames.page());
    EXPECT_EQ(count(text, "data:image/jpeg;base64,/9j/"), 1U);
    EXPECT_EQ(count(text, "id=\"frame-"), 2U);
    EXPECT_LT(text.find("id=\"frame-2\""), text.find("id=\"frame-1\"")) << "coarse to fine";
    const std::uint64_t bytes = std::filesystem::file_size(frames.file(1));
    const std::regex one("id=\"frame-1\">([^<]*)<");
    std::smatch found;
    ASSERT_TRUE(std::regex_search(text, found, one));
    EXPECT_EQ(static_cast<std::uint64_t>(found.length(1)), (bytes + 2) / 3 * 4);
}

TEST_F(ViewerPageTest, IsTheSameFileForTheSameRecording) {
    const RecordedFrames frames(2);
    ASSERT_TRUE(write(frames));
    const std::string first = readFile(frames.page());
    ASSERT_TRUE(write(frames));
    EXPECT_EQ(readFile(frames.page()), first);
}

TEST_F(ViewerPageTest, TurnsPicturesOfOtherFormatsIntoJpegInside) {
    for (const char* extension : {"png", "bmp", "tga"}) {
        const RecordedFrames frames(2, extension);
        const auto page = write(frames, true);
        ASSERT_TRUE(page) << page.message();
        EXPECT_THAT(page.value().warnings, IsEmpty());
        EXPECT_THAT(readFile(frames.page()), AllOf(HasSubstr("data:image/jpeg;base64,/9j/"),
                                                   HasSubstr("id=\"frame-1\">/9j/")));
    }
}

TEST_F(ViewerPageTest, CarriesPicturesThatBrowsersDoNotShow) {
    const RecordedFrames frames(2, "tga");
    const auto page = write(frames);
    ASSERT_TRUE(page) << page.message();
    EXPECT_THAT(page.value().warnings, ElementsAre("Browsers show no tga pictures: the page has "
                                                   "them inside, as JPEG."));
    EXPECT_EQ(recordingIn(frames.page())["inside"], true);
}

TEST_F(ViewerPageTest, LeavesOutWhatIsCutOffAndSaysSo) {
    for (const char* extension : {"jpg", "png"}) {
        const RecordedFrames frames(4, extension);
        frames.cut(2);
        const auto page = write(frames);
        ASSERT_TRUE(page) << page.message();
        EXPECT_EQ(page.value().pictures, 3);
        EXPECT_THAT(
            page.value().warnings,
            ElementsAre(AllOf(StartsWith("1 of 4 frames are cut off"), HasSubstr("House002"))));
        EXPECT_TRUE(recordingIn(frames.page())["files"][2].is_null());
    }
}

TEST_F(ViewerPageTest, BeginsWithTheFirstPictureThatIsWhole) {
    const RecordedFrames frames(3);
    frames.cut(0);
    ASSERT_TRUE(write(frames, true));
    EXPECT_EQ(recordingIn(frames.page())["first"], 1);
}

TEST_F(ViewerPageTest, SaysWhatIsDamagedInsideAWholeFile) {
    const RecordedFrames frames(2, "png");
    std::string bytes = readFile(frames.file(1));
    for (std::size_t at = 40; at < 48; ++at)
        bytes[at] = static_cast<char>(~bytes[at]);
    writeFile(frames.file(1), bytes);
    const auto page = write(frames, true);
    ASSERT_TRUE(page) << page.message();
    EXPECT_EQ(page.value().pictures, 1);
    EXPECT_THAT(page.value().warnings, ElementsAre(HasSubstr("House001.png")));
}

TEST_F(ViewerPageTest, IsNotWrittenWithoutAWholePicture) {
    const RecordedFrames frames(1);
    frames.cut(0);
    const auto page = write(frames);
    EXPECT_THAT(whyNot(page), HasSubstr("No frame in "));
    EXPECT_FALSE(std::filesystem::exists(frames.page()));
}

TEST_F(ViewerPageTest, TakesPicturesOfSeveralSizes) {
    const RecordedFrames frames(3);
    frames.write(1, 20, 48);
    ASSERT_TRUE(write(frames, true));
    EXPECT_EQ(recordingIn(frames.page())["width"], 64);
}

TEST_F(ViewerPageTest, TakesTenThousandFrames) {
    const RecordedFrames frames(1);
    for (int frame = 1; frame < 10000; ++frame)
        std::filesystem::create_hard_link(frames.file(0), frames.file(frame));
    const auto page = write(frames, true);
    ASSERT_TRUE(page) << page.message();
    EXPECT_EQ(page.value().pictures, 10000);
    EXPECT_EQ(recordingIn(frames.page())["files"].size(), 10000U);
    EXPECT_EQ(count(readFile(frames.page()), "id=\"frame-"), 9999U);
}

TEST_F(ViewerPageTest, LeavesSomebodyElsesFileOfItsNameAlone) {
    const RecordedFrames frames(1);
    writeFile(frames.page(), "<html>my own page</html>");
    EXPECT_THAT(whyNot(write(frames)), HasSubstr("is left alone"));
    EXPECT_EQ(readFile(frames.page()), "<html>my own page</html>");
    m_sources.overwrites = true;
    EXPECT_TRUE(write(frames));
    m_sources.overwrites = false;
    EXPECT_TRUE(write(frames)) << "its own page it replaces";
}

TEST_F(ViewerPageTest, HasTitlesThatCannotEndWhatTheyStandIn) {
    const std::string title = "</script><script>alert(1)</script> \"A\" 'B' & {{texts}} \u202Ex";
    const RecordedFrames frames(1);
    ASSERT_TRUE(write(frames));
    const std::size_t scripts = count(readFile(frames.page()), "<script");
    ASSERT_TRUE(write(frames, false, title));
    const std::string text = readFile(frames.page());
    EXPECT_EQ(count(text, "<script"), scripts);
    EXPECT_EQ(count(text, "</script>"), scripts);
    EXPECT_EQ(recordingIn(frames.page())["title"], title);
    EXPECT_THAT(text, HasSubstr("<title>&lt;/script&gt;"));
}

TEST_F(ViewerPageTest, TellsBrowsersToReachNothingElse) {
    const RecordedFrames frames(1);
    ASSERT_TRUE(write(frames));
    const std::string text = readFile(frames.page());
    EXPECT_THAT(text, HasSubstr("content=\"default-src 'none'; img-src 'self' file: data: blob:; "
                                "connect-src 'self'; style-src 'nonce-"));
    EXPECT_EQ(text.find("http://"), text.find("http://www.w3.org/2000/svg")) << "but for a name";
}

/// Lets no file grow past a size while it lives, as a full disk would.
class SmallDisk {
public:
    explicit SmallDisk(rlim_t bytes) {
        getrlimit(RLIMIT_FSIZE, &m_before);
        const rlimit limit{bytes, m_before.rlim_max};
        m_handler = std::signal(SIGXFSZ, SIG_IGN);
        setrlimit(RLIMIT_FSIZE, &limit);
    }
    ~SmallDisk() {
        setrlimit(RLIMIT_FSIZE, &m_before);
        std::signal(SIGXFSZ, m_handler);
    }

private:
    rlimit m_before{};
    void (*m_handler)(int) = nullptr;
};

TEST_F(ViewerPageTest, OnAFullDiskIsNotThereOrStaysAsItWas) {
    const RecordedFrames frames(3);
    ASSERT_TRUE(write(frames));
    const std::string before = readFile(frames.page());
    {
        const SmallDisk disk(before.size() / 2);
        EXPECT_THAT(whyNot(write(frames, true)), HasSubstr("Cannot write"));
    }
    EXPECT_EQ(readFile(frames.page()), before);
    EXPECT_EQ(std::distance(std::filesystem::directory_iterator(frames.folder()), {}), 4);
}

TEST_F(ViewerPageTest, SaysThatTheProgramsFilesAreMissing) {
    const RecordedFrames frames(1);
    m_sources.viewer_folder = frames.folder();
    EXPECT_THAT(whyNot(write(frames)), AllOf(HasSubstr("viewer.html"), HasSubstr("Install")));
    EXPECT_FALSE(std::filesystem::exists(frames.page()));
}

TEST(PageTexts, AreThereInAllLanguages) {
    const Json texts = Json::parse(pageTextsJson({SOURCES / "host/locale"}));
    EXPECT_EQ(texts["en"]["play"], "Play");
    for (const char* language : {"de", "es", "fr", "ja", "zh"}) {
        EXPECT_EQ(texts[language].size(), texts["en"].size()) << language;
        EXPECT_NE(texts[language]["drag_to_turn"], "Drag to turn") << language;
    }
}

} // namespace
} // namespace quarn::test
