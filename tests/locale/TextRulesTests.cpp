#include "tests/locale/TextRules.h"

#include <gmock/gmock.h>

namespace locale_rules {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

std::vector<std::string> formOf(const char* english, const char* local,
                                Space space = Space::strings) {
    return faultsOfForm({"de", space, english, local});
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

} // namespace
} // namespace locale_rules
