#include "tests/host/app/TestCommand.h"
#include "tests/host/document/DocumentFixtures.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using testing::HasSubstr;

class VisibilityCommandsTest : public HostTest {
protected:
    VisibilityCommandsTest() { m_id = document().objects().addPoint(L"Tower", {0, 0, 0}).id; }

    Document& document() { return Document::of(session.document()); }
    bool isVisible() { return document().objects().find(m_id)->visible; }

    KM_UUID m_id = KM_nil_uuid;
};

TEST_F(VisibilityCommandsTest, HideAndShowTakeAName) {
    document().objects().addPoint(L"North gate", {1, 2, 3});
    DocumentObject& gate = *document().objects().findByName(L"North gate");
    ASSERT_EQ(run(L"_-Hide \"north GATE\""), CQuarnCommand::success);
    EXPECT_FALSE(gate.visible);
    EXPECT_TRUE(isVisible());
    ASSERT_EQ(run(L"_-Show \"North gate\""), CQuarnCommand::success);
    EXPECT_TRUE(gate.visible);
}

TEST_F(VisibilityCommandsTest, HideTakesAnId) {
    ASSERT_EQ(run(L"_-Hide " + KM_UuidToString(m_id)), CQuarnCommand::success);
    EXPECT_FALSE(isVisible());
}

TEST_F(VisibilityCommandsTest, HidingWhatIsHiddenSucceeds) {
    const KM_wString id = KM_UuidToString(m_id);
    ASSERT_EQ(run(L"_-Hide " + id), CQuarnCommand::success);
    EXPECT_EQ(run(L"_-Hide " + id), CQuarnCommand::success);
    EXPECT_FALSE(isVisible());
}

TEST_F(VisibilityCommandsTest, AnUnknownNameIsToldAndNothingChanges) {
    document().objects().addPoint(L"Mark", {1, 2, 3});
    EXPECT_EQ(run(L"_-Hide Tower Nobody Mark"), CQuarnCommand::cancel);
    EXPECT_THAT(printed(),
                HasSubstr("There is no object called \"Nobody\"; List shows the names."));
    EXPECT_TRUE(isVisible()) << "not even the one before";
}

TEST_F(VisibilityCommandsTest, SeveralObjectsAreNamedOneAfterTheOther) {
    const DocumentObject& mark = document().objects().addPoint(L"Mark", {1, 2, 3});
    ASSERT_EQ(run(L"_-Hide Tower Mark"), CQuarnCommand::success);
    EXPECT_FALSE(isVisible());
    EXPECT_FALSE(mark.visible);
    ASSERT_EQ(run(L"_-Show Mark Tower _Enter"), CQuarnCommand::success);
    EXPECT_TRUE(isVisible());
    EXPECT_TRUE(mark.visible);
}

TEST_F(VisibilityCommandsTest, ALineWithoutWordsMeansTheSelection) {
    const DocumentObject& mark = document().objects().addPoint(L"Mark", {1, 2, 3});
    document().objects().select(mark.id);
    ASSERT_EQ(run(L"_-Hide"), CQuarnCommand::success);
    EXPECT_FALSE(mark.visible);
    EXPECT_FALSE(mark.selected) << "what is hidden is in the selection no more";
    EXPECT_TRUE(isVisible());
    document().objects().select(mark.id);
    ASSERT_EQ(run(L"_-Hide Tower"), CQuarnCommand::success);
    EXPECT_FALSE(isVisible()) << "a name counts before the selection";
}

TEST_F(VisibilityCommandsTest, APersonNamesObjectsUntilEnter) {
    for (const wchar_t* answer : {L"Tower", L"_Enter"})
        front_end.addAnswer(answer);
    ASSERT_EQ(run(L"Hide"), CQuarnCommand::success);
    EXPECT_FALSE(isVisible());
    EXPECT_STREQ(front_end.questions()[0].prompt, L"Objects to hide");
}

} // namespace
} // namespace quarn::test
