#include "tests/host/dialogs/DialogFixture.h"

using namespace quarn;
using namespace quarn::test;

namespace {

class ScriptedChoices : public DialogTest {};

} // namespace

TEST_F(ScriptedChoices, DialogsTakeTheScriptsInTheirOrder) {
    std::string order;
    front_end.addDialog([&](HeadlessDialogWindow& window) {
        order += "first ";
        window.pressOk();
    });
    front_end.addDialog([&](HeadlessDialogWindow&) { order += "second"; });
    EXPECT_EQ(1, sample.DoModal());
    EXPECT_EQ(2, sample.DoModal());
    EXPECT_EQ(-1, sample.DoModal());
    EXPECT_EQ("first second", order);
    ASSERT_EQ(3U, front_end.dialogs().size()) << "also the one that nobody answered";
    EXPECT_EQ(L"Sample", front_end.dialogs()[0].title.View());
    EXPECT_EQ(7U, front_end.dialogs()[0].controls.size());
}

TEST_F(ScriptedChoices, FilesAreChosenInTheirOrderAndThenByNobody) {
    front_end.addFileChoice({FileChoice::Kind::chosen, "/a/b.quarn"});
    front_end.addFileChoice({FileChoice::Kind::given_up});
    FileQuestion question;
    question.kind = FileQuestion::Kind::save;
    question.title = L"Save as";
    EXPECT_EQ("/a/b.quarn", front_end.chooseFile(question).file);
    EXPECT_EQ(FileChoice::Kind::given_up, front_end.chooseFile(question).kind);
    EXPECT_EQ(FileChoice::Kind::nobody, front_end.chooseFile(question).kind);
    ASSERT_EQ(3U, front_end.fileQuestions().size());
    EXPECT_EQ(FileQuestion::Kind::save, front_end.fileQuestions()[0].kind);
    EXPECT_EQ(L"Save as", front_end.fileQuestions()[0].title.View());
}

TEST_F(ScriptedChoices, ScriptMayChooseALocationWhileItsDialogIsOpen) {
    front_end.addLocationChoice(Place{1.0, 2.0});
    front_end.addLocationChoice(std::nullopt);
    show(sample, [&](HeadlessDialogWindow&) {
        EXPECT_EQ(2.0, front_end.chooseLocation(L"Where?", {}).value().longitude_deg);
        EXPECT_FALSE(front_end.chooseLocation(L"Where?", {}));
    });
    EXPECT_EQ(2U, front_end.locationQuestions().size());
}
