#include "engine/display/DisplayMode.h"
#include "engine/images/Image.h"
#include "tests/host/app/TestCommand.h"
#include "tests/host/document/DocumentFixtures.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using testing::HasSubstr;

class DisplayEdgesTest : public HostTest {
protected:
    Document& document() { return Document::of(session.document()); }
};

TEST_F(DisplayEdgesTest, ChoiceIsForTheDisplayModeOfTheActiveView) {
    ASSERT_EQ(run(L"_-DisplayMode _Wireframe"), CQuarnCommand::success);
    ASSERT_EQ(run(L"_-DisplayEdges _All"), CQuarnCommand::success);
    EXPECT_EQ(document().edgesOf(wireframe_mode_id), MeshEdgeChoice::all);
    EXPECT_EQ(document().edgesOf(shaded_mode_id), MeshEdgeChoice::standard);
    ASSERT_EQ(run(L"_-DisplayMode _Shaded"), CQuarnCommand::success);
    ASSERT_EQ(run(L"_-DisplayEdges _Features"), CQuarnCommand::success);
    EXPECT_EQ(document().edgesOf(shaded_mode_id), MeshEdgeChoice::features);
    ASSERT_EQ(run(L"_-DisplayEdges _Enter"), CQuarnCommand::success);
    EXPECT_EQ(document().edgesOf(shaded_mode_id), MeshEdgeChoice::features);
    ASSERT_EQ(run(L"_-DisplayEdges _Standard"), CQuarnCommand::success);
    EXPECT_EQ(document().edgesOf(shaded_mode_id), MeshEdgeChoice::standard);
    EXPECT_EQ(document().edgesOf(wireframe_mode_id), MeshEdgeChoice::all);
}

TEST_F(DisplayEdgesTest, OtherWordsAreToldAndChangeNothing) {
    EXPECT_EQ(run(L"_-DisplayEdges Thick"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("Thick"));
    EXPECT_EQ(document().edgesOf(document().activeView().displayMode()->Id()),
              MeshEdgeChoice::standard);
}

TEST_F(DisplayEdgesTest, ChoiceChangesThePictureOfTheView) {
    addBox(document(), {-20, -20, -20}, {20, 20, 20});
    ViewState& view = document().activeView();
    view.setFrameSize(64, 48);
    ASSERT_EQ(run(L"_-DisplayMode _Shaded"), CQuarnCommand::success);
    view.redraw(0);
    const std::vector<std::uint8_t> plain = view.frameBuffer().rgba;
    ASSERT_EQ(run(L"_-DisplayEdges _Features"), CQuarnCommand::success);
    view.redraw(0);
    EXPECT_NE(view.frameBuffer().rgba, plain);
    ASSERT_EQ(run(L"_-DisplayEdges _None"), CQuarnCommand::success);
    view.redraw(0);
    EXPECT_EQ(view.frameBuffer().rgba, plain);
}

} // namespace
} // namespace quarn::test
