#include "kelmar/KM_wString.h"

#include <gtest/gtest.h>

#include <climits>
#include <string>

TEST(WideString, NullTextIsEmpty) {
    const wchar_t* null = nullptr;
    EXPECT_TRUE(KM_wString(null).IsEmpty());
    EXPECT_TRUE(KM_wString() == null);
    EXPECT_EQ(KM_wString(L"a").Compare(null), 1);
    KM_wString text(L"a");
    text += null;
    EXPECT_TRUE(text == L"a");
    EXPECT_TRUE(null + text + null == L"a");
    EXPECT_EQ(text.Find(null), -1);
    EXPECT_EQ(text.Replace(null, L"b"), 0);
}

TEST(WideString, ArrayEndsInZero) {
    EXPECT_EQ(KM_wString().Array()[0], L'\0');
    EXPECT_EQ(KM_wString(L"ab").Array()[2], L'\0');
}

TEST(WideString, IndexOutsideTheTextReadsZeroAndWritesNothing) {
    KM_wString text(L"abc");
    EXPECT_EQ(text[-1], L'\0');
    EXPECT_EQ(text[3], L'\0');
    text.SetAt(3, L'x');
    text.SetAt(-1, L'x');
    EXPECT_TRUE(text == L"abc");
    text.SetAt(1, L'x');
    EXPECT_TRUE(text == L"axc");
}

TEST(WideString, SumKeepsBothParts) {
    const KM_wString a(L"one");
    EXPECT_TRUE(a + KM_wString(L"two") == L"onetwo");
    EXPECT_TRUE(a + L"/" == L"one/");
    EXPECT_TRUE(L"/" + a == L"/one");
    KM_wString doubled(L"ab");
    doubled += doubled;
    EXPECT_TRUE(doubled == L"abab");
    doubled += L'!';
    EXPECT_TRUE(doubled == L"abab!");
}

TEST(WideString, ComparisonTellsCaseApart) {
    const KM_wString text(L"Wireframe");
    EXPECT_TRUE(text != L"wireframe");
    EXPECT_EQ(text.CompareNoCase(L"wIREFRAME"), 0);
    EXPECT_EQ(text.CompareNoCase(L"wIREFRAM"), 1);
    EXPECT_EQ(text.CompareNoCase(L"wIREFRAMES"), -1);
    EXPECT_EQ(KM_wString(L"a").Compare(L"b"), -1);
    EXPECT_EQ(KM_wString(L"b").CompareNoCase(L"A"), 1);
    EXPECT_TRUE(KM_wString(L"B") < KM_wString(L"a"));
}

TEST(WideString, CaseIsKnownBeyondAsciiWhateverTheLocale) {
    EXPECT_EQ(KM_wString(L"\u00C4rger").CompareNoCase(L"\u00E4RGER"), 0);
    EXPECT_EQ(KM_wString(L"\u0394\u03CC\u03BC\u03BF\u03C2")
                  .CompareNoCase(L"\u03B4\u038C\u039C\u039F\u03A3"),
              0);
    EXPECT_EQ(KM_wString(L"\u0412\u0418\u0414\u0401").CompareNoCase(L"\u0432\u0438\u0434\u0451"),
              0);
    EXPECT_EQ(KM_wString(L"\u0141\u017B\u0178").CompareNoCase(L"\u0142\u017C\u00FF"), 0);
    EXPECT_NE(KM_wString(L"\u00D7").CompareNoCase(L"\u00F7"), 0) << "times and divide are no pair";
    KM_wString text(L"\u00E0b\u00FFz\u0451\u03C9");
    text.MakeUpper();
    EXPECT_TRUE(text == L"\u00C0B\u0178Z\u0401\u03A9");
    text.MakeLower();
    EXPECT_TRUE(text == L"\u00E0b\u00FFz\u0451\u03C9");
}

TEST(WideString, EveryLetterIsItsCapitalAndItsSmallLetterWhenCaseIsIgnored) {
    int pairs = 0;
    for (wchar_t code = 1; code < 0x20000; ++code) {
        const KM_wString letter(std::wstring(1, code));
        KM_wString lower(letter), upper(letter);
        lower.MakeLower();
        upper.MakeUpper();
        pairs += upper == lower ? 0 : 1;
        ASSERT_EQ(letter.CompareNoCase(lower.Array()), 0) << "character " << static_cast<int>(code);
        ASSERT_EQ(letter.CompareNoCase(upper.Array()), 0) << "character " << static_cast<int>(code);
    }
    EXPECT_GT(pairs, 2000);
}

TEST(WideString, FindGivesTheFirstIndexOrMinusOne) {
    const KM_wString text(L"banana");
    EXPECT_EQ(text.Find(L'n'), 2);
    EXPECT_EQ(text.Find(L'x'), -1);
    EXPECT_EQ(text.Find(L"ana"), 1);
    EXPECT_EQ(text.Find(L"nab"), -1);
    EXPECT_EQ(text.Find(L""), 0);
}

TEST(WideString, PartsAreCutToTheText) {
    const KM_wString text(L"abcdef");
    EXPECT_TRUE(text.Mid(2, 3) == L"cde");
    EXPECT_TRUE(text.Mid(4, INT_MAX) == L"ef");
    EXPECT_TRUE(text.Mid(6, 1).IsEmpty());
    EXPECT_TRUE(text.Mid(INT_MAX, INT_MAX).IsEmpty());
    EXPECT_TRUE(text.Mid(-2, 3) == L"a");
    EXPECT_TRUE(text.Mid(2, -1).IsEmpty());
    EXPECT_TRUE(text.Left(2) == L"ab");
    EXPECT_TRUE(text.Left(9) == L"abcdef");
    EXPECT_TRUE(text.Left(-1).IsEmpty());
    EXPECT_TRUE(text.Right(2) == L"ef");
    EXPECT_TRUE(text.Right(9) == L"abcdef");
    EXPECT_TRUE(text.Right(-1).IsEmpty());
}

TEST(WideString, TrimTakesUnicodeBlanksFromTheEndsOnly) {
    KM_wString text(L"\t \u00A0a b\u3000\r\n");
    KM_wString left(text), right(text);
    text.TrimLeftAndRight();
    EXPECT_TRUE(text == L"a b");
    left.TrimLeft();
    EXPECT_TRUE(left == L"a b\u3000\r\n");
    right.TrimRight();
    EXPECT_TRUE(right == L"\t \u00A0a b");
    KM_wString blank(L" \t ");
    blank.TrimLeftAndRight();
    EXPECT_TRUE(blank.IsEmpty());
}

TEST(WideString, RemoveAndReplaceCountWhatTheyChange) {
    KM_wString extension(L".p.n.g");
    EXPECT_EQ(extension.Remove(L'.'), 3);
    EXPECT_TRUE(extension == L"png");
    KM_wString name(L"a/b/c");
    EXPECT_EQ(name.Replace(L'/', L'_'), 2);
    EXPECT_TRUE(name == L"a_b_c");
    EXPECT_EQ(name.Replace(L"_", L"__"), 2);
    EXPECT_TRUE(name == L"a__b__c");
    EXPECT_EQ(name.Replace(L"__", nullptr), 2);
    EXPECT_TRUE(name == L"abc");
    EXPECT_EQ(name.Replace(L"", L"x"), 0);
    KM_wString run(L"aaaaa");
    EXPECT_EQ(run.Replace(L"aa", L"b"), 2);
    EXPECT_TRUE(run == L"bba");
}

TEST(WideString, ReplacementMayPointIntoTheTextItself) {
    KM_wString text(L"xax");
    EXPECT_EQ(text.Replace(L"x", text.Array()), 2);
    EXPECT_TRUE(text == L"xaxaxax");
}
