#include "host/document/Document.h"
#include "tests/host/app/TestCommand.h"
#include "tests/host/document/DocumentFixtures.h"
#include "tests/import/ModelFixtures.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using testing::EndsWith;
using testing::HasSubstr;

class ModelCommandsTest : public HostTest {
protected:
    Document& document() { return Document::of(session.document()); }

    CQuarnCommand::result runOn(const wchar_t* command, const std::filesystem::path& file) {
        const KM_wString line =
            KM_wString(command) + L" \"" + KM_wString::FromUtf8(file.string()) + L"\"";
        return run(line);
    }

    TemporaryFolder folder;
    std::filesystem::path triangle =
        folder.write("my model.obj", "o Roof\nv 0 0 0\nv 1000 0 0\nv 0 1000 0\nf 1 2 3\n");
};

TEST_F(ModelCommandsTest, ImportAddsToTheOpenDocumentAndShowsTheModel) {
    const unsigned int number = document().serialNumber();
    ASSERT_EQ(runOn(L"_-Import", triangle), CQuarnCommand::success);
    EXPECT_EQ(
        printed(),
        "my model.obj: 1 object with 1 triangle. Z is taken as up, as in most files of this kind; "
        "the option Up of Open and Import changes that.\n");
    EXPECT_EQ(document().serialNumber(), number);
    ASSERT_NE(document().objects().findByName(L"Roof"), nullptr);
    EXPECT_EQ(document().activeView().viewport().TargetPoint(), KM_3dPoint(500, 500, 0));
    EXPECT_GT(document().activeView().viewport().TargetDistance(), 1000.0);
}

TEST_F(ModelCommandsTest, TheAxisThatPointsUpInTheFileIsAnOption) {
    ASSERT_EQ(runOn(L"_-Import [Up] _Y", triangle), CQuarnCommand::success);
    const KM_BoundingBox turned = document().objects().visibleBox();
    EXPECT_EQ(turned.m_max, KM_3dPoint(1000, 0, 1000)) << "y of the file is up";
    ASSERT_EQ(runOn(L"_-Open [Up] _Z", triangle), CQuarnCommand::success);
    EXPECT_EQ(document().objects().visibleBox().m_max, KM_3dPoint(1000, 1000, 0));
    ASSERT_EQ(runOn(L"_-Open [Up] _Y [Up] _ByFormat", triangle), CQuarnCommand::success);
    EXPECT_EQ(document().objects().visibleBox().m_max, KM_3dPoint(1000, 1000, 0));
}

TEST_F(ModelCommandsTest, TheAxisOfTheProgramThatWroteTheFileIsTakenAndTold) {
    const auto file =
        folder.write("signed.obj", "# Blender 3.6.0\nv 0 0 0\nv 1 0 0\nv 0 2 0\nf 1 2 3\n");
    ASSERT_EQ(runOn(L"_-Open", file), CQuarnCommand::success);
    EXPECT_THAT(printed(), HasSubstr("triangle. Y is taken as up, as Blender writes it; the option "
                                     "Up of Open and Import changes that."));
    EXPECT_EQ(document().objects().visibleBox().m_max, KM_3dPoint(1, 0, 2));
    ASSERT_EQ(runOn(L"_-Open [Up] _Z", file), CQuarnCommand::success);
    EXPECT_THAT(printed(), EndsWith("signed.obj: 1 object with 1 triangle\n")) << "who asks knows";
}

TEST_F(ModelCommandsTest, AnUnknownAxisIsToldAndNothingIsRead) {
    EXPECT_EQ(runOn(L"_-Import [Up] _X", triangle), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("\"_X\" is no option here. The options are ByFormat, Y, Z."));
    EXPECT_TRUE(document().objects().empty());
}

TEST_F(ModelCommandsTest, ASecondImportLeavesTheCameraAlone) {
    runOn(L"Import", triangle);
    run(L"Camera Location 1,2,3 Target 0,0,0 _Enter");
    ASSERT_EQ(runOn(L"Import", triangle), CQuarnCommand::success);
    EXPECT_EQ(document().objects().objects().size(), 2U);
    EXPECT_EQ(document().activeView().viewport().CameraLocation(), KM_3dPoint(1, 2, 3));
}

TEST_F(ModelCommandsTest, OpenMakesANewDocumentAndEmptiesTheRecord) {
    RecordKeeper keeper;
    keeper.record.SetFrameCount(3);
    runOn(L"Import", triangle);
    const unsigned int number = document().serialNumber();
    ASSERT_EQ(runOn(L"Open", triangle), CQuarnCommand::success);
    EXPECT_NE(document().serialNumber(), number);
    EXPECT_EQ(document().objects().objects().size(), 1U);
    EXPECT_EQ(keeper.record.FrameCount(), 100);
    EXPECT_EQ(CQuarnDoc::FromRuntimeSerialNumber(number), nullptr);
}

TEST_F(ModelCommandsTest, AFileThatCannotBeReadLeavesTheDocument) {
    runOn(L"Import", triangle);
    front_end.clearPrinted();
    const unsigned int number = document().serialNumber();
    EXPECT_EQ(runOn(L"Open", folder.path() / "none.obj"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("none.obj"));
    EXPECT_EQ(runOn(L"Open", folder.write("bad.stl", "solid nothing\nendsolid\n")),
              CQuarnCommand::failure);
    EXPECT_EQ(runOn(L"Open", folder.path() / "house.quarn"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("house.quarn"));
    EXPECT_EQ(runOn(L"Open", folder.write("bad.quarn", "no document")), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("bad.quarn"));
    EXPECT_EQ(document().serialNumber(), number);
    EXPECT_EQ(document().objects().objects().size(), 1U);
}

TEST_F(ModelCommandsTest, NewOpensAnEmptyDocument) {
    runOn(L"Import", triangle);
    ASSERT_EQ(run(L"New"), CQuarnCommand::success);
    EXPECT_TRUE(document().objects().empty());
    EXPECT_STREQ(document().activeView().name(), L"Perspective");
}

TEST_F(ModelCommandsTest, AMissingFileNameIsNamed) {
    EXPECT_EQ(run(L"Import"), CQuarnCommand::cancel);
    EXPECT_THAT(printed(), HasSubstr("Model or document file"));
}

} // namespace
} // namespace quarn::test
