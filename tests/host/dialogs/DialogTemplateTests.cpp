#include "host/dialogs/DialogTemplates.h"

#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

using namespace quarn;
using namespace quarn::test;
using testing::HasSubstr;
using Kind = DialogControl::Kind;

namespace {

constexpr const char* GOOD = R"({
    "id": 12,
    "title": {"text": "Frames", "id": 90001},
    "controls": [
        {"id": 31, "kind": "integer", "label": {"text": "Count", "id": 90002},
         "hint": {"text": "How many", "id": 90003}},
        {"id": 32, "kind": "button", "label": {"text": "Reset"}, "joins_row": true}
    ]
})";

class DialogTemplateFile : public ::testing::Test {
protected:
    std::filesystem::path file() const { return folder / "12.dialog.json"; }
    Result<DialogTemplate> read(const std::string& text) {
        writeFile(file(), text);
        return readDialogTemplate(file(), texts);
    }
    /// Why a file is refused.
    std::string fault(const std::string& text) {
        const Result<DialogTemplate> form = read(text);
        if (form)
            return "taken";
        EXPECT_THAT(form.message(), HasSubstr(file().string()));
        EXPECT_THAT(form.message(), HasSubstr("Mend it"));
        return form.message();
    }
    /// Why the good file is refused with one text in it replaced by another.
    std::string faultWith(const std::string& what, const std::string& other) {
        std::string text = GOOD;
        const std::size_t place = text.find(what);
        EXPECT_NE(std::string::npos, place) << what;
        return fault(text.replace(place, what.size(), other));
    }

    TempFolder folder;
    StringTables texts{"de"};
};

} // namespace

TEST_F(DialogTemplateFile, GivesTitleAndControlsFromTopToBottom) {
    const Result<DialogTemplate> read_form = read(GOOD);
    ASSERT_TRUE(read_form) << read_form.message();
    const DialogTemplate& form = read_form.value();
    EXPECT_EQ(12, form.id);
    EXPECT_EQ(L"Frames", form.title.View());
    ASSERT_EQ(2U, form.controls.size());
    EXPECT_EQ(31, form.controls[0].id);
    EXPECT_EQ(Kind::integer, form.controls[0].kind);
    EXPECT_EQ(L"Count", form.controls[0].label.View());
    EXPECT_EQ(L"How many", form.controls[0].hint.View());
    EXPECT_FALSE(form.controls[0].joins_row);
    EXPECT_EQ(Kind::button, form.controls[1].kind);
    EXPECT_TRUE(form.controls[1].hint.IsEmpty());
    EXPECT_TRUE(form.controls[1].joins_row);
}

TEST_F(DialogTemplateFile, KnowsEveryKindOfControl) {
    std::string text = R"({"id": 12, "title": {"text": "All"}, "controls": [)";
    int id = 100;
    for (const char* kind : {"text", "number", "integer", "date", "time", "combo_box", "button"}) {
        text += id > 100 ? ", " : "";
        text += R"({"id": )" + std::to_string(id) + R"(, "kind": ")" + kind +
                R"(", "label": {"text": "x"}})";
        ++id;
    }
    const Result<DialogTemplate> form = read(text + "]}");
    ASSERT_TRUE(form) << form.message();
    std::vector<Kind> kinds;
    for (const DialogControl& control : form.value().controls)
        kinds.push_back(control.kind);
    EXPECT_EQ((std::vector<Kind>{Kind::text, Kind::number, Kind::integer, Kind::date, Kind::time,
                                 Kind::combo_box, Kind::button}),
              kinds);
}

TEST_F(DialogTemplateFile, SpeaksTheUsersLanguageWhereATextHasANumberOfTheTables) {
    writeFile(folder / "de.json", R"({"strings": {"90001": "Bilder", "90003": "Wie viele"}})");
    ASSERT_TRUE(texts.load("test", {folder.path()}));
    const Result<DialogTemplate> form = read(GOOD);
    ASSERT_TRUE(form) << form.message();
    EXPECT_EQ(L"Bilder", form.value().title.View());
    EXPECT_EQ(L"Count", form.value().controls[0].label.View()) << "no table has 90002";
    EXPECT_EQ(L"Wie viele", form.value().controls[0].hint.View());
    EXPECT_EQ(L"Reset", form.value().controls[1].label.View());
}

TEST_F(DialogTemplateFile, MayHaveNoControls) {
    EXPECT_EQ("taken", fault(R"({"id": 12, "title": {"text": "Sure?"}, "controls": []})"));
}

TEST_F(DialogTemplateFile, ThatIsNoJsonIsRefusedWithTheLine) {
    EXPECT_THAT(fault("{\n  \"id\": 12,\n  oops\n}"), HasSubstr("it is no JSON from line 3 on"));
    EXPECT_THAT(fault(""), HasSubstr("it is no JSON"));
    EXPECT_THAT(faultWith("Frames", "\xFF\xFE"), HasSubstr("it is no JSON"));
}

TEST_F(DialogTemplateFile, WithWhatNoTemplateKnowsIsRefused) {
    EXPECT_THAT(fault("[]"), HasSubstr("the file is no object"));
    EXPECT_THAT(faultWith("\"title\"", "\"caption\""), HasSubstr("has \"caption\""));
    EXPECT_THAT(faultWith("\"hint\"", "\"tip\""), HasSubstr("control 1: it has \"tip\""));
    EXPECT_THAT(faultWith("\"kind\": \"integer\"", "\"kind\": \"slider\""),
                HasSubstr("control 1: \"kind\" is none of \"text\", \"number\""));
    EXPECT_THAT(faultWith("{\"text\": \"Reset\"}", "{\"text\": \"Reset\", \"font\": 3}"),
                HasSubstr("control 2: \"label\" has \"font\""));
}

TEST_F(DialogTemplateFile, WithoutWhatEveryTemplateHasIsRefused) {
    EXPECT_THAT(fault("{}"), HasSubstr("\"id\" is no whole number above 0"));
    EXPECT_THAT(fault(R"({"id": 12})"), HasSubstr("\"title\" is missing"));
    EXPECT_THAT(fault(R"({"id": 12, "title": {"text": "x"}})"),
                HasSubstr("\"controls\" is no list"));
    EXPECT_THAT(faultWith("{\"text\": \"Reset\"}", "{}"),
                HasSubstr("control 2: \"label\" has no \"text\" in English"));
    EXPECT_THAT(faultWith("{\"text\": \"Reset\"}", "\"Reset\""),
                HasSubstr("control 2: \"label\" is no object"));
    EXPECT_THAT(faultWith("\"Reset\"", "\"\""), HasSubstr("no \"text\" in English"));
}

TEST_F(DialogTemplateFile, WithWrongNumbersIsRefused) {
    EXPECT_THAT(faultWith("12", "13"), HasSubstr("\"id\" is 13"));
    EXPECT_THAT(faultWith("12", "-12"), HasSubstr("\"id\" is no whole number above 0"));
    EXPECT_THAT(faultWith("31", "31.5"), HasSubstr("control 1: \"id\" is no whole number"));
    EXPECT_THAT(faultWith("31", "2"), HasSubstr("OK and Cancel are 1 and 2"));
    EXPECT_THAT(faultWith("31", "99999999999"), HasSubstr("control 1: \"id\""));
    EXPECT_THAT(faultWith("31", "18446744073709551615"), HasSubstr("control 1: \"id\""));
    EXPECT_THAT(faultWith("31", "1e999"), HasSubstr("it has a number that is too large"));
    EXPECT_THAT(faultWith("32", "31"), HasSubstr("control 2 has the id 31, as one before it"));
    EXPECT_THAT(faultWith("90001", "\"90001\""), HasSubstr("the \"id\" of \"title\""));
    EXPECT_THAT(faultWith("90003", "0"), HasSubstr("the \"id\" of \"hint\""));
}

TEST_F(DialogTemplateFile, WhoseFirstControlJoinsARowIsRefused) {
    EXPECT_THAT(faultWith("\"kind\": \"integer\"", "\"kind\": \"integer\", \"joins_row\": true"),
                HasSubstr("control 1 has no row to join"));
    EXPECT_THAT(faultWith("true", "1"), HasSubstr("\"joins_row\" is neither true nor false"));
}

TEST_F(DialogTemplateFile, ThatIsLargerThanAnyFormIsRefused) {
    EXPECT_THAT(fault(std::string((1 << 20) + 1, ' ')), HasSubstr("more than 1048576 bytes"));
    std::string text = R"({"id": 12, "title": {"text": "x"}, "controls": [{})";
    for (int i = 0; i < 200; ++i)
        text += ", {}";
    EXPECT_THAT(fault(text + "]}"), HasSubstr("more than 200 controls"));
}

TEST_F(DialogTemplateFile, ThatIsAFolderIsRefused) {
    std::filesystem::create_directory(file());
    const Result<DialogTemplate> form = readDialogTemplate(file(), texts);
    ASSERT_FALSE(form);
    EXPECT_THAT(form.message(), HasSubstr(file().string()));
}

// ---- Finding

TEST_F(DialogTemplateFile, IsTakenFromTheFirstFolderThatHasIt) {
    for (const char* name : {"a", "b"}) {
        std::filesystem::create_directory(folder / name);
        writeFile(folder / name / "12.dialog.json",
                  std::string(R"({"id": 12, "title": {"text": ")") + name +
                      R"("}, "controls": []})");
    }
    const std::filesystem::path folders[] = {folder / "none", folder / "b", folder / "a"};
    const Result<DialogTemplate> form = findDialogTemplate(12, folders, texts);
    ASSERT_TRUE(form) << form.message();
    EXPECT_EQ(L"b", form.value().title.View());
}

TEST_F(DialogTemplateFile, ThatNoFolderHasIsToldWithTheFolders) {
    const std::filesystem::path folders[] = {folder / "a", folder / "b"};
    const Result<DialogTemplate> form = findDialogTemplate(12, folders, texts);
    ASSERT_FALSE(form);
    EXPECT_EQ("There is no dialog template 12.dialog.json in " + (folder / "a").string() + ", " +
                  (folder / "b").string() + ". Install the plug-in with all its files.",
              form.message());
}

TEST(DialogTemplateFolders, AreBesideThePlugInThenThoseOfTheSession) {
    const std::filesystem::path session_folders[] = {"/share/one", "/share/two"};
    const std::vector<std::filesystem::path> expected = {
        "/plug-ins/dialogs/Name", "/share/one/Name", "/share/two/Name", "/share/one", "/share/two"};
    EXPECT_EQ(expected, dialogTemplateFolders("/plug-ins/Name.qnp", session_folders));
}
