// Which way a model is up, asked of a person in a window.
#include "host/document/Document.h"
#include "tests/host/app/TestCommand.h"
#include "tests/host/document/DocumentFixtures.h"
#include "tests/import/ModelFixtures.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using testing::EndsWith;
using testing::HasSubstr;
using testing::Not;

/// A person who looks at both pictures before they answer.
class LookingFrontEnd final : public ScriptedFrontEnd {
public:
    using Picture = std::vector<std::uint8_t>;

    std::optional<ModelUp> chooseUpAxis(const UpAxisQuestion& question) override {
        ++asked;
        file = question.file;
        taken = question.taken;
        y_up = look(question, ModelUp::y);
        z_up = look(question, ModelUp::z);
        return answer;
    }

    std::optional<ModelUp> answer;
    int asked = 0;
    std::filesystem::path file;
    ModelUp taken = ModelUp::y;
    Picture y_up;
    Picture z_up;

private:
    static Picture look(const UpAxisQuestion& question, ModelUp up) {
        const ShownPicture shown = question.draw(up, 48, 36);
        EXPECT_EQ(shown.rgba.size(),
                  static_cast<std::size_t>(4 * shown.width_px * shown.height_px));
        return {shown.rgba.begin(), shown.rgba.end()};
    }
};

class UpAxisTest : public testing::Test {
protected:
    Document& document() { return Document::of(session.document()); }
    std::string printed() const { return KM_wString(front_end.printed()).ToUtf8(); }
    CQuarnCommand::result runInWindow(const std::string& command,
                                      const std::filesystem::path& file) {
        const std::string line = command + " \"" + file.string() + '"';
        return session.runCommand(KM_wString::FromUtf8(line).View(), true);
    }
    /// The box of all objects reaches from the origin to here.
    KM_3dPoint top() { return document().objects().visibleBox().m_max; }

    TemporaryFolder folder;
    /// One that is tall along y, as it is with z up and with y up.
    std::filesystem::path tower = folder.write(
        "tower.obj", "v 0 0 0\nv 1 0 0\nv 0 5 0\nv 0 0 -2\nf 1 3 2\nf 1 2 4\nf 1 4 3\nf 2 3 4\n");
    LookingFrontEnd front_end;
    Session session{front_end, {{}, {}, "C", {}}};
};

TEST_F(UpAxisTest, APersonIsAskedOfAFileThatOnlyHabitDecides) {
    ASSERT_EQ(runInWindow("Open", tower), CQuarnCommand::success) << printed();
    EXPECT_EQ(front_end.asked, 1);
    EXPECT_EQ(front_end.file, tower);
    EXPECT_EQ(front_end.taken, ModelUp::z);
}

TEST_F(UpAxisTest, EachPictureIsThatOfTheModelAsItStandsThen) {
    const std::filesystem::path upright = folder.write(
        "upright.obj", "v 0 0 0\nv 1 0 0\nv 0 0 5\nv 0 2 0\nf 1 3 2\nf 1 2 4\nf 1 4 3\nf 2 3 4\n");
    runInWindow("Open", tower);
    EXPECT_NE(front_end.y_up, front_end.z_up);
    const LookingFrontEnd::Picture tower_with_y_up = front_end.y_up;
    runInWindow("Open", upright);
    EXPECT_EQ(front_end.z_up, tower_with_y_up);
}

TEST_F(UpAxisTest, TheOtherWayTurnsTheModelThatIsOpened) {
    front_end.answer = ModelUp::y;
    ASSERT_EQ(runInWindow("Open", tower), CQuarnCommand::success);
    EXPECT_EQ(top(), KM_3dPoint(1, 2, 5));
    EXPECT_FALSE(document().isModified());
    EXPECT_THAT(printed(), EndsWith("tower.obj: 1 object with 4 triangles\n")) << "who chose knows";
    const KM_3dPoint camera = document().activeView().viewport().CameraLocation();
    document().activeView().setFrameSize(40, 30);
    document().activeView().redraw(0);
    const auto picture = document().activeView().frameBuffer().rgba;
    ASSERT_EQ(runInWindow("-Open [Up] _Y", tower), CQuarnCommand::success);
    EXPECT_EQ(document().activeView().viewport().CameraLocation(), camera);
    document().activeView().setFrameSize(40, 30);
    document().activeView().redraw(0);
    EXPECT_EQ(document().activeView().frameBuffer().rgba, picture);
}

TEST_F(UpAxisTest, TheWayThatStandsIsKeptWhenItIsChosen) {
    front_end.answer = ModelUp::z;
    ASSERT_EQ(runInWindow("Open", tower), CQuarnCommand::success);
    EXPECT_EQ(top(), KM_3dPoint(1, 5, 0));
    EXPECT_THAT(printed(), EndsWith("tower.obj: 1 object with 4 triangles\n"));
}

TEST_F(UpAxisTest, WhoGivesTheQuestionUpKeepsWhatWasTakenAndIsTold) {
    ASSERT_EQ(runInWindow("Open", tower), CQuarnCommand::success);
    EXPECT_EQ(top(), KM_3dPoint(1, 5, 0));
    EXPECT_THAT(printed(), HasSubstr("Z is taken as up, as in most files of this kind"));
}

TEST_F(UpAxisTest, AModelIsTurnedBesideWhatTheDocumentHas) {
    document().objects().addPoint(L"P", {1, 2, 3});
    front_end.answer = ModelUp::y;
    ASSERT_EQ(runInWindow("Import", tower), CQuarnCommand::success);
    EXPECT_EQ(top(), KM_3dPoint(1, 2, 5));
    EXPECT_EQ(*document().objects().findByName(L"P")->point, KM_3dPoint(1, 2, 3));
}

TEST_F(UpAxisTest, NobodyIsAskedInScriptsNorWhereItIsKnown) {
    EXPECT_EQ(runInWindow("-Open", tower), CQuarnCommand::success);
    EXPECT_EQ(runInWindow("Open [Up] _Y", tower), CQuarnCommand::success);
    const auto script = KM_wString::FromUtf8("Open \"" + tower.string() + '"');
    EXPECT_EQ(session.runCommand(script.View()), CQuarnCommand::success);
    const auto blender = folder.write("signed.obj", "# Blender 3.6.0\nv 0 0 0\nv 1 0 0\nv 0 2 0\n"
                                                    "f 1 2 3\n");
    EXPECT_EQ(runInWindow("Open", blender), CQuarnCommand::success);
    EXPECT_EQ(runInWindow("Open", folder.path() / "none.obj"), CQuarnCommand::failure);
    EXPECT_EQ(front_end.asked, 0);
}

TEST_F(UpAxisTest, AModelWithoutPicturesIsOpenedAllTheSame) {
    const auto vast = folder.write("vast.obj", "v 0 0 0\nv 3e37 0 0\nv 0 3e37 0\nf 1 2 3\n");
    ASSERT_EQ(runInWindow("Open", vast), CQuarnCommand::success) << printed();
    EXPECT_TRUE(front_end.y_up.empty());
    EXPECT_TRUE(front_end.z_up.empty());
    EXPECT_EQ(document().objects().objects().size(), 1U);
}

} // namespace
} // namespace quarn::test
