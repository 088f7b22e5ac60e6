#include "tests/locale/TextRules.h"

#include <gmock/gmock.h>

namespace locale_rules {
namespace {

using testing::Contains;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

std::vector<std::string> formOf(const char* english, const char* local,
                                Space space = Space::strings) {
    return faultsOfForm({"de", space, english, local});
}

std::vector<std::string> writingOf(const char* language, const char* local,
                                   const char* english = "English") {
    return faultsOfWriting({language, Space::strings, english, local});
}

TEST(FormOfTexts, CodesAreThoseThatPrintAndThoseThatAreNamed) {
    EXPECT_THAT(formatCodes("%s at %5.2f%% of %ls, %1 %2"),
                ElementsAre("%s", "%5.2f", "%ls", "%1", "%2"));
    EXPECT_THAT(formatCodes("100 % sure"), IsEmpty());
}

TEST(FormOfTexts, PrintedCodesKeepTheirOrderAndNamedOnesOnlyTheirNumber) {
    EXPECT_THAT(formOf("%s of %d", "%s von %d"), IsEmpty());
    EXPECT_THAT(formOf("%s of %d", "%d von %s"), SizeIs(1));
    EXPECT_THAT(formOf("%s of %d", "%s von %s"), SizeIs(1));
    EXPECT_THAT(formOf("%s", "ohne"), SizeIs(1));
    EXPECT_THAT(formOf("%1 of %2", "%2 von %1"), IsEmpty());
    EXPECT_THAT(formOf("%1 of %2", "%1 von %1"), SizeIs(1));
}

TEST(FormOfTexts, EndsOfLinesAndBlanksAtEndsAreKept) {
    EXPECT_THAT(formOf("Done\n", "Fertig\n"), IsEmpty());
    EXPECT_FALSE(formOf("Done\n", "Fertig").empty());
    EXPECT_FALSE(formOf("Done. ", "Fertig.").empty());
    EXPECT_FALSE(formOf("Done", " Fertig").empty());
    EXPECT_FALSE(formOf("Two\nlines", "Zwei Zeilen").empty());
    EXPECT_FALSE(formOf("Done", "").empty());
}

TEST(FormOfTexts, AnAccessKeyIsKept) {
    EXPECT_THAT(formOf("&Open", "Ö&ffnen"), IsEmpty());
    EXPECT_THAT(formOf("&Open", "Öffnen"), SizeIs(1));
    EXPECT_THAT(formOf("Time & place", "Zeit & Ort"), IsEmpty());
}

TEST(FormOfTexts, NamesOfOptionsHaveNothingThatCannotBeTyped) {
    EXPECT_THAT(formOf("A", "EinName", Space::option_names), IsEmpty());
    for (const char* name : {"Ein Name", "A=B", "A,B", "[A]", "(A)", "_A"})
        EXPECT_THAT(formOf("A", name, Space::option_names), SizeIs(1)) << name;
    EXPECT_THAT(formOf("Yes", "Ja doch", Space::option_values), SizeIs(1));
    EXPECT_THAT(formOf("A", "Ein Name"), IsEmpty());
}

TEST(WritingOfTexts, BrokenAndInvisibleCharactersAreFound) {
    for (const char* broken : {"Gr\u00C3\u00B6\u00C3\u009Fe", "Gr\uFFFD\uFFFDe", "Gro\u0308\u00DFe",
                               "\uFEFFGr\u00F6\u00DFe", "Gr\u00F6\u200BSe", "A\tB"})
        EXPECT_THAT(writingOf("de", broken), Contains("broken or invisible characters")) << broken;
    EXPECT_THAT(writingOf("de", "Größe"), IsEmpty());
}

TEST(WritingOfTexts, EachLanguageKeepsToItsScript) {
    EXPECT_THAT(writingOf("de", "図 Größe"), SizeIs(1));
    EXPECT_THAT(writingOf("zh", "图のサイズ"), SizeIs(1));
    EXPECT_THAT(writingOf("zh", "選択"), SizeIs(1));
    EXPECT_THAT(writingOf("ja", "选择"), SizeIs(1));
    EXPECT_THAT(writingOf("ja", "選択する"), IsEmpty());
    EXPECT_THAT(writingOf("zh", "选择"), IsEmpty());
}

TEST(WritingOfTexts, TheMarkAtTheEndIsThatOfTheEnglishText) {
    EXPECT_THAT(writingOf("zh", "完成。", "Done.\n"), IsEmpty());
    EXPECT_THAT(writingOf("zh", "完成", "Done.\n"), SizeIs(1));
    EXPECT_THAT(writingOf("de", "Öffnen …", "Open…"), IsEmpty());
    EXPECT_THAT(writingOf("de", "Öffnen …", "Open..."), IsEmpty());
    EXPECT_THAT(writingOf("de", "Öffnen", "Open…"), SizeIs(1));
    EXPECT_THAT(writingOf("fr", "Nom :", "Name"), SizeIs(1));
}

TEST(WritingOfTexts, ThreeDotsTypewriterApostrophesAndTwoBlanksAreFound) {
    EXPECT_THAT(writingOf("es", "Abrir...", "Open..."), SizeIs(1));
    EXPECT_THAT(writingOf("fr", "l'image"), SizeIs(1));
    EXPECT_THAT(writingOf("fr", "l’image"), IsEmpty());
    EXPECT_THAT(writingOf("de", "zwei  Worte"), SizeIs(1));
}

TEST(WritingOfTexts, QuotesAreTheLanguagesOwnAndPaired) {
    EXPECT_THAT(writingOf("de", "das „Haus“"), IsEmpty());
    EXPECT_THAT(writingOf("fr", "la « maison »"), IsEmpty());
    EXPECT_THAT(writingOf("es", "la «casa»"), IsEmpty());
    EXPECT_THAT(writingOf("ja", "「家」"), IsEmpty());
    EXPECT_THAT(writingOf("zh", "“家”"), IsEmpty());
    EXPECT_THAT(writingOf("de", "das “Haus”"), SizeIs(1));
    EXPECT_THAT(writingOf("fr", "la „maison“"), SizeIs(1));
    EXPECT_THAT(writingOf("zh", "「家」"), SizeIs(1));
    EXPECT_THAT(writingOf("de", "„Haus"), SizeIs(1));
}

TEST(WritingOfTexts, WideCharactersHaveWideMarksAroundThem) {
    for (const char* narrow : {"幅(点)", "幅:", "幅,高", "幅 (点 1)"})
        EXPECT_FALSE(writingOf("zh", narrow).empty()) << narrow;
    for (const char* wide : {"幅（点）", "已由 (%s) 改为 (%s)", "打开(&O)", "时间 14:30"})
        EXPECT_THAT(writingOf("zh", wide), IsEmpty()) << wide;
    EXPECT_THAT(writingOf("de", "Breite（Punkte）"), SizeIs(2)); // also of another script
}

TEST(WritingOfTexts, FrenchSetsMarksOfTwoPartsApartAndSpanishOpensQuestions) {
    EXPECT_THAT(writingOf("fr", "Nom : un"), IsEmpty());
    EXPECT_THAT(writingOf("fr", "Nom: un"), SizeIs(1));
    EXPECT_THAT(writingOf("es", "¿Guardar?", "Save?"), IsEmpty());
    EXPECT_THAT(writingOf("es", "Guardar?", "Save?"), SizeIs(1));
}

TEST(WritingOfTexts, AListOfForbiddenSignsIsNoWriting) {
    EXPECT_THAT(
        writingOf("fr", "Interdits : \\ / : * ? \" < > |", "Not allowed: \\ / : * ? \" < > |"),
        IsEmpty());
}

} // namespace
} // namespace locale_rules
