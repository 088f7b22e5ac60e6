#include "tests/exports/Symbols.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <functional>

namespace {

using exports::declarationsBelow;
using exports::exportedSymbols;
using exports::mentions;
using exports::qualifiedName;
using Strings = std::vector<std::string>;

std::string listed(const Strings& lines) {
    std::string text;
    for (const std::string& line : lines) {
        text += line + "\n";
    }
    return text;
}

/// The symbols of `library` that `isPublished` does not own, one a line.
std::string strangersIn(const std::string& library,
                        const std::function<bool(const std::string&)>& isPublished) {
    Strings strangers = exportedSymbols(library);
    std::erase_if(strangers, isPublished);
    return listed(strangers);
}

/// A free operator is published if a published type takes part in it.
bool isOperatorOf(const std::string& declarations, const std::string& symbol) {
    for (std::size_t at = 2; at < symbol.size(); ++at) {
        const bool begins = std::isdigit(static_cast<unsigned char>(symbol[at])) != 0 &&
                            std::isdigit(static_cast<unsigned char>(symbol[at - 1])) == 0;
        const Strings name = begins ? qualifiedName("_Z" + symbol.substr(at)) : Strings{};
        if (!name.empty() && mentions(declarations, name.front())) {
            return true;
        }
    }
    return false;
}

bool isDeclaredIn(const std::string& declarations, const std::string& symbol) {
    const Strings name = qualifiedName(symbol);
    if (name.empty()) {
        return isOperatorOf(declarations, symbol);
    }
    return mentions(declarations, name.front());
}

/// The entry points of every plug-in file.
constexpr const char* PLUG_IN_ENTRIES = "QuarnPlugInDeveloperAddress\n"
                                        "QuarnPlugInDeveloperCountry\n"
                                        "QuarnPlugInDeveloperEmail\n"
                                        "QuarnPlugInDeveloperFax\n"
                                        "QuarnPlugInDeveloperOrganization\n"
                                        "QuarnPlugInDeveloperPhone\n"
                                        "QuarnPlugInDeveloperWebsite\n"
                                        "QuarnPlugInSdkServiceRelease\n"
                                        "QuarnPlugInSdkVersion\n"
                                        "QuarnPlugInUpdateURL\n";

TEST(Exports, ThePlugInShowsItsEntryPointsAndNothingElse) {
    EXPECT_EQ(listed(exportedSymbols(ZOETRIX_PLUGIN_PATH)), PLUG_IN_ENTRIES);
}

#ifdef VEXUI_PLUGIN_PATH
TEST(Exports, TheDialogPlugInShowsItsDialogsToo) {
    EXPECT_EQ(listed(exportedSymbols(VEXUI_PLUGIN_PATH)),
              PLUG_IN_ENTRIES + std::string("ZelVexUiDay\n"
                                            "ZelVexUiPathAnimation\n"
                                            "ZelVexUiSeason\n"
                                            "ZelVexUiTurnTable\n"));
}
#endif

TEST(Exports, TheGeometryToolkitShowsWhatItsHeadersDeclare) {
    const std::string declarations = declarationsBelow(QUARN_SOURCE_DIR "/kelmar");
    ASSERT_FALSE(exportedSymbols(KELMAR_LIBRARY).empty());
    EXPECT_EQ(strangersIn(KELMAR_LIBRARY,
                          [&](const auto& symbol) { return isDeclaredIn(declarations, symbol); }),
              "");
}

TEST(Exports, TheHostShowsItsInterfaceAndThePublishedFrontEnd) {
    const std::string interface =
        declarationsBelow(QUARN_SOURCE_DIR "/sdk") + declarationsBelow(QUARN_SOURCE_DIR "/kelmar");
    std::string front_end;
    for (const std::string room :
         {"front_end", "session", "cities", "sun", "clock", "almanac", "sunpath"})
        front_end += declarationsBelow(QUARN_SOURCE_DIR "/host/" + room);
    ASSERT_FALSE(exportedSymbols(QNCORE_LIBRARY).empty());
    EXPECT_EQ(strangersIn(QNCORE_LIBRARY,
                          [&](const auto& symbol) {
                              const Strings name = qualifiedName(symbol);
                              return name.size() > 1 && name[0] == "quarn"
                                         ? mentions(front_end, name[1])
                                         : isDeclaredIn(interface, symbol);
                          }),
              "");
}

TEST(Exports, ASymbolIsOwnedByItsOutermostName) {
    EXPECT_EQ(qualifiedName("_ZN5quarn4Host3runEi"), (Strings{"quarn", "Host", "run"}));
    EXPECT_EQ(qualifiedName("_ZNK10KM_3dPoint7IsValidEv"), (Strings{"KM_3dPoint", "IsValid"}));
    EXPECT_EQ(qualifiedName("_ZTV7CQuarnX"), Strings{"CQuarnX"});
    EXPECT_EQ(qualifiedName("_ZThn16_N7CQuarnX4stopEv"), (Strings{"CQuarnX", "stop"}));
    EXPECT_EQ(qualifiedName("_ZGVZN5quarn4nameEvE5value"), (Strings{"quarn", "name"}));
    EXPECT_EQ(qualifiedName("_ZNSt6vectorIiSaIiEE9push_backEOi"), Strings{"std"});
    EXPECT_EQ(qualifiedName("_ZSt4moveIRiEvv"), Strings{"std"});
    EXPECT_EQ(qualifiedName("_ZNK8nlohmann6detail9exception4whatEv").front(), "nlohmann");
    EXPECT_EQ(qualifiedName("stbi_load"), Strings{"stbi_load"});
    EXPECT_TRUE(qualifiedName("_ZmlRK7KM_Axis").empty());
}

TEST(Exports, AStrangerIsNotTakenForAPartOfTheInterface) {
    const std::string declarations = "class KM_Axis { int length; };";
    EXPECT_TRUE(isDeclaredIn(declarations, "_ZN7KM_Axis6lengthEv"));
    EXPECT_TRUE(isDeclaredIn(declarations, "_ZmldRK7KM_Axis"));
    EXPECT_FALSE(isDeclaredIn(declarations, "_ZN6KM_Axi6lengthEv"));
    EXPECT_FALSE(isDeclaredIn(declarations, "_ZNSt6vectorIiSaIiEE9push_backEOi"));
    EXPECT_FALSE(isDeclaredIn(declarations, "_ZN6Assimp8ImporterC1Ev"));
    EXPECT_FALSE(isDeclaredIn(declarations, "_ZplRK9aiVector2S1_"));
    EXPECT_FALSE(isDeclaredIn(declarations, "stbi_load"));
}

} // namespace
