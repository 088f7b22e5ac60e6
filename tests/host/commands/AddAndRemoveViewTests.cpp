#include "engine/display/DisplayMode.h"
#include "sdk/qncore/QnApp.h"
#include "tests/host/app/TestCommand.h"
#include "tests/host/document/DocumentFixtures.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using testing::HasSubstr;

class AddAndRemoveViewTest : public HostTest {
protected:
    Document& document() { return Document::of(session.document()); }
    ViewState& view() { return document().activeView(); }
    std::size_t viewCount() { return document().views().size(); }
};

TEST_F(AddAndRemoveViewTest, ANewViewIsActiveAndLooksAlongAStandardDirectionAtTheSameTarget) {
    ASSERT_EQ(run(L"Camera Location 10,0,0 Target 1,2,3 _Enter"), CQuarnCommand::success);
    ASSERT_EQ(run(L"ViewportSize 320 200"), CQuarnCommand::success);
    ASSERT_EQ(run(L"AddView \"North side\" Front"), CQuarnCommand::success);
    EXPECT_STREQ(view().name().Array(), L"North side");
    EXPECT_EQ(-view().viewport().CameraZ(), KM_3dVector(0, 1, 0));
    EXPECT_EQ(view().viewport().TargetPoint(), KM_3dPoint(1, 2, 3));
    EXPECT_TRUE(view().viewport().IsParallelProjection());
    EXPECT_EQ(view().displayMode()->Id(), wireframe_mode_id);
    EXPECT_EQ(view().frameWidth(), 320);
    EXPECT_EQ(view().frameHeight(), 200);
    EXPECT_EQ(viewCount(), 5U);
}

TEST_F(AddAndRemoveViewTest, ACopyHasTheActiveViewsCameraModeAndSize) {
    ASSERT_EQ(run(L"Camera Location 10,-5.5,3 Target 1,2,3 Lens 24 _Enter"),
              CQuarnCommand::success);
    ASSERT_EQ(run(L"ViewportSize 640 480"), CQuarnCommand::success);
    ASSERT_EQ(run(L"DisplayMode Rendered"), CQuarnCommand::success);
    const ViewState& original = view();
    ASSERT_EQ(run(L"AddView Twin _Copy"), CQuarnCommand::success);
    ASSERT_NE(&view(), &original);
    EXPECT_TRUE(view().viewport() == original.viewport());
    EXPECT_EQ(view().displayMode(), original.displayMode());
    EXPECT_EQ(view().frameWidth(), 640);
    ASSERT_EQ(run(L"AddView Triplet _Enter"), CQuarnCommand::success);
    EXPECT_TRUE(view().viewport() == original.viewport());
}

TEST_F(AddAndRemoveViewTest, ATakenNameIsRefusedBeforeAnythingElseIsAsked) {
    EXPECT_EQ(run(L"AddView top"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("There is a view \"Top\" already. Give the new one another "
                                     "name."));
    EXPECT_EQ(run(L"AddView \"\""), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("A view needs a name"));
    EXPECT_EQ(run(L"AddView Side Left"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("\"Left\" is no option here"));
    EXPECT_EQ(run(L"AddView Side"), CQuarnCommand::cancel);
    EXPECT_EQ(viewCount(), 4U);
}

TEST_F(AddAndRemoveViewTest, ViewsAreRemovedByNameUntilOneIsLeft) {
    ASSERT_EQ(run(L"RemoveView perspective"), CQuarnCommand::success);
    EXPECT_STREQ(view().name().Array(), L"Right");
    EXPECT_EQ(run(L"RemoveView Perspective"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("There is no view \"Perspective\"."));
    ASSERT_EQ(run(L"RemoveView Right"), CQuarnCommand::success);
    ASSERT_EQ(run(L"RemoveView Top"), CQuarnCommand::success);
    EXPECT_EQ(run(L"RemoveView Front"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("The view \"Front\" is the document's last one and stays."));
    EXPECT_EQ(viewCount(), 1U);
    ASSERT_EQ(run(L"AddView Perspective Perspective"), CQuarnCommand::success);
    EXPECT_TRUE(view().viewport().IsPerspectiveProjection());
}

TEST_F(AddAndRemoveViewTest, AViewThatAScriptRemovesStaysUntilTheScriptsCommandHasEnded) {
    TestScriptCommand outer(L"Outer", [&](const CQuarnCommandContext& context) {
        CQuarnView* active = QuarnApp().ActiveView();
        const unsigned int number = context.Document().RuntimeSerialNumber();
        EXPECT_TRUE(QuarnApp().RunScript(number, L"RemoveView Perspective", 0));
        EXPECT_STREQ(active->MainViewport().Name(), L"Perspective");
        EXPECT_FALSE(QuarnApp().RunScript(number, L"AddView Perspective Copy", 0)) << "still there";
        EXPECT_EQ(viewCount(), 4U);
        return CQuarnCommand::success;
    });
    add(outer);
    ASSERT_EQ(run(L"Outer"), CQuarnCommand::success);
    EXPECT_EQ(viewCount(), 3U);
    EXPECT_EQ(document().findView(L"Perspective"), nullptr);
}

} // namespace
} // namespace quarn::test
