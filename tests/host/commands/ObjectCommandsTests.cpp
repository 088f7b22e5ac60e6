#include "tests/host/app/TestCommand.h"
#include "tests/host/document/DocumentFixtures.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

/// A document with the points "Tower", "Mark" and "North gate".
class ObjectCommandsTest : public HostTest {
protected:
    ObjectCommandsTest() {
        for (const wchar_t* name : {L"Tower", L"Mark", L"North gate"})
            objects().addPoint(name, {0, 0, 0});
    }

    ObjectTable& objects() { return Document::of(session.document()).objects(); }
    DocumentObject& object(const wchar_t* name) { return *objects().findByName(name); }

    std::vector<std::string> names() {
        std::vector<std::string> all;
        for (const auto& each : objects().objects())
            all.push_back(each->name.ToUtf8());
        return all;
    }
    std::vector<std::string> selected() {
        std::vector<std::string> some;
        for (const auto& each : objects().objects())
            if (each->selected)
                some.push_back(each->name.ToUtf8());
        return some;
    }
};

// ---- Select

TEST_F(ObjectCommandsTest, SelectAddsObjectsAndTellsHowManyAreSelected) {
    ASSERT_EQ(run(L"_-Select Mark _Enter"), CQuarnCommand::success);
    EXPECT_THAT(selected(), ElementsAre("Mark"));
    ASSERT_EQ(run(L"_-Select \"north gate\" Mark"), CQuarnCommand::success);
    EXPECT_THAT(selected(), ElementsAre("Mark", "North gate"));
    EXPECT_EQ(printed(), "1 object selected.\n2 objects selected.\n");
}

TEST_F(ObjectCommandsTest, SelectTakesAllVisibleObjectsNoneOrTheLast) {
    objects().setVisible(object(L"Mark").id, false);
    ASSERT_EQ(run(L"_-Select _All"), CQuarnCommand::success);
    EXPECT_THAT(selected(), ElementsAre("Tower", "North gate"));
    ASSERT_EQ(run(L"_-Select _None Mark _Enter"), CQuarnCommand::success);
    EXPECT_THAT(selected(), ElementsAre("Mark"));
    ASSERT_EQ(run(L"_-Select _Last"), CQuarnCommand::success);
    EXPECT_THAT(selected(), ElementsAre("Mark", "North gate"));
    ASSERT_EQ(run(L"_-Select _None"), CQuarnCommand::success);
    EXPECT_THAT(selected(), IsEmpty());
    EXPECT_THAT(printed(), HasSubstr("0 objects selected."));
}

TEST_F(ObjectCommandsTest, ACancelledSelectLeavesTheSelection) {
    run(L"_-Select Mark");
    EXPECT_EQ(run(L"_-Select _None Tower Nobody"), CQuarnCommand::cancel);
    EXPECT_THAT(selected(), ElementsAre("Mark"));
    EXPECT_EQ(run(L"_-Select"), CQuarnCommand::cancel);
    EXPECT_THAT(printed(), HasSubstr("Select needs an answer to \"Objects to select\" "
                                     "(All, None, Last); none was given."));
}

TEST_F(ObjectCommandsTest, APersonSelectsUntilEnter) {
    for (const wchar_t* answer : {L"Nobody", L"All", L"Enter", L"_Enter"})
        front_end.addAnswer(answer);
    ASSERT_EQ(run(L"Select"), CQuarnCommand::success);
    EXPECT_THAT(selected(), ElementsAre("Tower", "Mark", "North gate"));
    EXPECT_THAT(printed(), HasSubstr("There is no object called \"Enter\""));
}

TEST_F(ObjectCommandsTest, LastInAnEmptyDocumentSelectsNothing) {
    run(L"New");
    ASSERT_EQ(run(L"_-Select _Last"), CQuarnCommand::success);
    EXPECT_THAT(printed(), HasSubstr("0 objects selected."));
}

// ---- Delete

TEST_F(ObjectCommandsTest, DeleteTakesNames) {
    ASSERT_EQ(run(L"_-Delete Tower Tower \"North gate\""), CQuarnCommand::success);
    EXPECT_THAT(names(), ElementsAre("Mark"));
    EXPECT_EQ(printed(), "2 objects deleted.\n");
}

TEST_F(ObjectCommandsTest, DeleteTakesTheSelection) {
    run(L"_-Select Tower");
    front_end.clearPrinted();
    ASSERT_EQ(run(L"_-Delete"), CQuarnCommand::success);
    EXPECT_THAT(names(), ElementsAre("Mark", "North gate"));
    EXPECT_EQ(objects().selectedCount(), 0);
    EXPECT_EQ(printed(), "1 object deleted.\n");
}

TEST_F(ObjectCommandsTest, DeleteOfAnUnknownObjectDeletesNothing) {
    EXPECT_EQ(run(L"_-Delete Tower Nobody"), CQuarnCommand::cancel);
    EXPECT_EQ(run(L"_-Delete"), CQuarnCommand::cancel) << "nothing is selected";
    EXPECT_EQ(names().size(), 3U);
    EXPECT_THAT(printed(), HasSubstr("Delete needs an answer to \"Objects to delete\""));
}

// ---- Rename

TEST_F(ObjectCommandsTest, RenameGivesAnotherName) {
    const KM_UUID id = object(L"Mark").id;
    ASSERT_EQ(run(L"_-Rename Mark \"  South gate \""), CQuarnCommand::success);
    EXPECT_THAT(names(), ElementsAre("Tower", "South gate", "North gate"));
    EXPECT_EQ(object(L"south gate").id, id);
    ASSERT_EQ(run(L"_-Rename " + KM_UuidToString(id) + L" MARK"), CQuarnCommand::success);
    ASSERT_EQ(run(L"_-Rename mark Mark"), CQuarnCommand::success) << "its own name";
    EXPECT_THAT(names(), ElementsAre("Tower", "Mark", "North gate"));
}

TEST_F(ObjectCommandsTest, RenameRefusesATakenName) {
    EXPECT_EQ(run(L"_-Rename Mark TOWER"), CQuarnCommand::failure);
    EXPECT_EQ(printed(), "Another object is called \"Tower\"; give a free name.\n");
    EXPECT_THAT(names(), ElementsAre("Tower", "Mark", "North gate"));
}

TEST_F(ObjectCommandsTest, RenameRefusesNamesThatCannotBeTold) {
    EXPECT_EQ(run(L"_-Rename Mark \"  \""), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("The name of an object cannot be empty."));
    EXPECT_EQ(run(L"_-Rename Mark \"a\x07"
                  L"b\""),
              CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("cannot hold control characters."));
    EXPECT_EQ(run(L"_-Rename Mark " + KM_UuidToString(object(L"Tower").id)),
              CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("cannot look like an id."));
    EXPECT_THAT(names(), ElementsAre("Tower", "Mark", "North gate"));
}

TEST_F(ObjectCommandsTest, RenameWorksOnTheOneSelectedObjectAndOffersItsName) {
    run(L"_-Select Mark");
    front_end.addAnswer(L"Flag \"A\"");
    ASSERT_EQ(run(L"Rename"), CQuarnCommand::success);
    EXPECT_THAT(names(), ElementsAre("Tower", "Flag \"A\"", "North gate"));
    ASSERT_EQ(front_end.questions().size(), 1U);
    EXPECT_STREQ(front_end.questions()[0].prompt, L"New name");
    EXPECT_STREQ(*front_end.questions()[0].default_answer, L"Mark");
}

TEST_F(ObjectCommandsTest, ANameWithQuotesIsGivenByAPersonOrById) {
    objects().rename(object(L"Mark").id, L"Flag \"A\"");
    for (const wchar_t* answer : {L"Flag \"A\"", L"_Enter"})
        front_end.addAnswer(answer);
    ASSERT_EQ(run(L"Delete"), CQuarnCommand::success);
    EXPECT_THAT(names(), ElementsAre("Tower", "North gate"));
}

} // namespace
} // namespace quarn::test
