#include "tests/zoetrix/fixtures/PlugInFixture.h"
#include "zoetrix/commands/cmdZoetrix.h"
#include "zoetrix/plugin/ZoetrixUtilities.h"

namespace {

KM_wString repeated(wchar_t character, int count) {
    return KM_wString(std::wstring(static_cast<std::size_t>(count), character));
}

KM_wString cleaned(const wchar_t* extension) {
    KM_wString text = extension;
    CleanExtention(text);
    return text;
}

class ViewNames : public PlugInFixture {};

} // namespace

TEST(FileNames, LengthOf255IsTheLongestThatIsValid) {
    EXPECT_TRUE(IsValidFileName(repeated(L'a', 255)));
    EXPECT_FALSE(IsValidFileName(repeated(L'a', 256)));
    EXPECT_FALSE(IsValidFileName(repeated(L'a', 5000)));
}

TEST(FileNames, EmptyNameIsInvalidAndNeedsNoReplacement) {
    KM_wString name;
    EXPECT_FALSE(IsValidFileName(name));
    EXPECT_EQ(0, ReplaceInvalidFileChar(name));
    EXPECT_TRUE(name.IsEmpty());
}

TEST(FileNames, EachOfTheNineForbiddenCharactersIsRefusedAndReplaced) {
    for (const wchar_t character : std::wstring(L"\\|/:*?\"<>")) {
        KM_wString name = L"ab";
        name += character;
        EXPECT_FALSE(IsValidFileName(name)) << static_cast<char>(character);
        EXPECT_EQ(1, ReplaceInvalidFileChar(name));
        EXPECT_EQ(L"ab_", name.View());
        EXPECT_TRUE(IsValidFileName(name));
    }
}

TEST(FileNames, OtherCharactersAreAllowed) {
    EXPECT_TRUE(IsValidFileName(L" .ä日-_(1)'%s"));
}

TEST(FileNames, ReplacementCountsEveryCharacter) {
    KM_wString name = L"a<b>c";
    EXPECT_EQ(2, ReplaceInvalidFileChar(name));
    EXPECT_EQ(L"a_b_c", name.View());
}

TEST(FileNames, SeparatorsAndControlCharactersLeaveTheFolder) {
    EXPECT_TRUE(StaysInsideFolder(L" Walk \"1\" ä..jpg"));
    for (const wchar_t* name : {L"../Walk", L"a\\b", L"a\nb", L"a\tb", L"a\u007f", L"a\u0085b"})
        EXPECT_FALSE(StaysInsideFolder(name)) << KM_wString(name).ToUtf8();
}

TEST(FileNames, QuotesAndLineBreaksStayOutOfScripts) {
    EXPECT_TRUE(CanBeQuotedInScript(L"/tmp/a b;'c/Walk.html"));
    for (const wchar_t* path : {L"/tmp/a\"b", L"/tmp/a\nb", L"/tmp/a\rb", L"/tmp/a\u2028b"})
        EXPECT_FALSE(CanBeQuotedInScript(path)) << KM_wString(path).ToUtf8();
}

TEST(Extensions, EveryDotIsRemoved) {
    EXPECT_EQ(L"jpg", cleaned(L"..jpg").View());
    EXPECT_EQ(L"png", cleaned(L".png").View());
    EXPECT_EQ(L"png", cleaned(L"p.n.g").View());
    EXPECT_EQ(L"", cleaned(L"...").View());
}

TEST_F(ViewNames, ListAppendsTheNamesInTheHostsOrder) {
    KM_ClassArray<KM_wString> names;
    names.Append(L"before");
    EXPECT_TRUE(GetViewList(names));
    const KM_ClassArray<KM_wString> expected = {L"before", L"Top", L"Front", L"Right",
                                                L"Perspective"};
    EXPECT_EQ(expected, names);
}

TEST_F(ViewNames, ViewIsFoundByItsNameAndInOtherCaseOnlyWhenCaseIsIgnored) {
    CQuarnView* front = &view(L"Front");
    EXPECT_EQ(front, CZoetrixUtilities::FindQuarnViewByName(doc(), L"Front", false));
    EXPECT_EQ(front, CZoetrixUtilities::FindQuarnViewByName(doc(), L"fRONT", true));
    EXPECT_EQ(nullptr, CZoetrixUtilities::FindQuarnViewByName(doc(), L"front", false));
    EXPECT_EQ(nullptr, CZoetrixUtilities::FindQuarnViewByName(doc(), L"Fron", true));
    EXPECT_EQ(nullptr, CZoetrixUtilities::FindQuarnViewByName(doc(), L"", true));
}
