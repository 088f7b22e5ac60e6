#include "tests/host/app/TestCommand.h"

namespace quarn::test {
namespace {

CQuarnCommand::result nothingToDo(const CQuarnCommandContext&) {
    return CQuarnCommand::success;
}

std::string refusal(CommandRegistry& registry, CQuarnCommand& command) {
    const Result<void> added = registry.add(command);
    return added ? "" : added.message();
}

TEST(CommandRegistry, FindsACommandByEnglishAndLocalNameIgnoringCase) {
    CommandRegistry registry;
    TestCommand command(L"Open", nothingToDo);
    command.m_local_name = L"Öffnen";
    ASSERT_TRUE(registry.add(command));
    EXPECT_EQ(registry.find(L"OPEN")->command, &command);
    EXPECT_EQ(registry.find(L"öffnen")->command, &command);
    EXPECT_EQ(registry.find(L"öffnen", true), nullptr);
    EXPECT_EQ(registry.find(L"Ope"), nullptr);
}

TEST(CommandRegistry, RefusesNamesAndIdsThatAreTaken) {
    CommandRegistry registry;
    TestCommand first(L"Open", nothingToDo);
    ASSERT_TRUE(registry.add(first));
    TestCommand same_name(L"OPEN", nothingToDo);
    EXPECT_EQ(refusal(registry, same_name), "There is a command OPEN already");
    TestCommand same_local(L"Other", nothingToDo);
    same_local.m_local_name = L"open";
    EXPECT_EQ(refusal(registry, same_local), "There is a command Other already");
    TestCommand same_id(L"Third", nothingToDo);
    same_id.m_id = first.m_id;
    EXPECT_EQ(refusal(registry, same_id),
              "The id of the command Third belongs to the command Open already");
    EXPECT_EQ(registry.sortedByName().size(), 1U);
}

TEST(CommandRegistry, RefusesANilIdAndANameWithOtherThanLettersAndDigits) {
    CommandRegistry registry;
    TestCommand nil(L"Nil", nothingToDo);
    nil.m_id = KM_nil_uuid;
    EXPECT_EQ(refusal(registry, nil), "The command Nil has no id");
    for (const wchar_t* name : {L"", L"Two Words", L"_Open", L"Größe"}) {
        TestCommand command(name, nothingToDo);
        EXPECT_NE(refusal(registry, command).find("is no command name"), std::string::npos);
    }
}

TEST(CommandRegistry, ListsCommandsByNameAndForgetsRemovedOnes) {
    CommandRegistry registry;
    TestCommand view(L"view", nothingToDo);
    TestCommand add(L"Add", nothingToDo);
    TestCommand sun(L"Sun", nothingToDo);
    for (CQuarnCommand* command :
         {&static_cast<CQuarnCommand&>(view), &static_cast<CQuarnCommand&>(add),
          &static_cast<CQuarnCommand&>(sun)})
        ASSERT_TRUE(registry.add(*command));
    registry.remove(sun);
    const auto sorted = registry.sortedByName();
    ASSERT_EQ(sorted.size(), 2U);
    EXPECT_STREQ(sorted[0].english_name, L"Add");
    EXPECT_STREQ(sorted[1].english_name, L"view");
}

TEST_F(HostTest, ACommandThatIsDestroyedCanNoLongerBeRun) {
    {
        TestCommand command(L"Brief", nothingToDo);
        add(command);
        EXPECT_EQ(run(L"Brief"), CQuarnCommand::success);
    }
    EXPECT_EQ(run(L"Brief"), CQuarnCommand::failure);
}

TEST_F(HostTest, NoTwoHostCommandsCollide) {
    EXPECT_EQ(printed(), "");
    EXPECT_NE(Application::current()->commands().find(L"Run"), nullptr);
    EXPECT_NE(Application::current()->commands().find(L"LoadPlugIn"), nullptr);
}

} // namespace
} // namespace quarn::test
