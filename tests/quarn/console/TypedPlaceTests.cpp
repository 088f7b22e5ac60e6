#include "quarn/console/TypedPlace.h"

#include "quarn/console/TerminalFrontEnd.h"
#include "quarn/words/Words.h"

#include <deque>
#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using program::placeFromText;
using testing::HasSubstr;

/// "latitude longitude" of what is read; a refusal as it stands.
std::wstring read(std::wstring_view text) {
    const auto typed = placeFromText(text);
    const Place* const place = std::get_if<Place>(&typed);
    return place ? program::textFromPlace(*place) : std::get<std::wstring>(typed);
}

/// A person who types these lines and then ends the input.
class TypedLines final : public program::LineSource {
public:
    explicit TypedLines(std::deque<std::wstring> lines) : m_lines(std::move(lines)) {}
    program::LineRead read(const std::wstring& prompt, program::LineUse,
                           const program::Completer&) override {
        prompts.push_back(prompt);
        if (m_lines.empty())
            return {program::LineRead::Kind::end, {}};
        program::LineRead line = {program::LineRead::Kind::line, m_lines.front()};
        m_lines.pop_front();
        return line;
    }
    void remember(std::wstring_view, program::LineUse) override {}
    bool isTerminal() const override { return true; }

    std::vector<std::wstring> prompts;

private:
    std::deque<std::wstring> m_lines;
};

class LocationAtThePrompt : public testing::Test {
protected:
    std::optional<Place> choose(std::deque<std::wstring> lines) {
        TypedLines typed(std::move(lines));
        program::TerminalFrontEnd front_end(typed, program::ConsoleFrontEnd::Prints::hidden);
        front_end.keepWords();
        const auto chosen = front_end.chooseLocation(L"Set Animation Location", {51.5, -0.12});
        prompts = typed.prompts;
        told = front_end.takeKeptWords();
        return chosen;
    }

    std::vector<std::wstring> prompts;
    std::string told;
};

TEST(TypedPlace, IsACityByItsName) {
    EXPECT_EQ(L"37.98 23.73", read(L"athens"));
    EXPECT_EQ(read(L"Birmingham, United Kingdom"), read(L"birmingham,united kingdom"));
}

TEST(TypedPlace, IsALatitudeAndALongitudePartedInAnyOfThreeWays) {
    for (const wchar_t* text : {L"51.5 -0.12", L"51.5, -0.12", L"51.5;-0.12", L"51,5; -0,12",
                                L"51,5 -0,12", L"51,5, -0,12", L"51.5N 0.12W", L" 51.5   -0.12 "})
        EXPECT_EQ(L"51.5 -0.12", read(text)) << program::utf8Text(text);
    EXPECT_EQ(L"-90 180", read(L"-90 180"));
}

TEST(TypedPlace, IsRefusedWhereTheCommasCouldMeanTwoPlaces) {
    EXPECT_EQ(L"Part the latitude and the longitude with a semicolon.", read(L"1,2,3"));
}

TEST(TypedPlace, IsRefusedWhereItIsNotOnTheEarth) {
    for (const wchar_t* text : {L"90.5 0", L"-91 0", L"0 180.5", L"0 -181"})
        EXPECT_EQ(L"A place has a latitude from -90 to 90 and a longitude from -180 to 180.",
                  read(text));
}

TEST(TypedPlace, ThatNoCityIsCalledIsRefusedWithThoseThatMayBeMeant) {
    EXPECT_THAT(program::utf8Text(read(L"Lodnon")), HasSubstr("London, United Kingdom"));
    EXPECT_THAT(program::utf8Text(read(L"Birmingham")), HasSubstr("Birmingham, United States"));
    EXPECT_THAT(program::utf8Text(read(L"qqqqqqqqqqqq")), HasSubstr("as in 51.5 -0.12"));
    EXPECT_THAT(program::utf8Text(read(L"51.5")),
                HasSubstr("There is no city \"51.5\" in the list."));
}

TEST_F(LocationAtThePrompt, IsAskedWithTheTitleAndThePlaceThatIsThere) {
    const auto place = choose({L"Athens"});
    ASSERT_TRUE(place);
    EXPECT_NEAR(37.98, place->latitude_deg, 0.005);
    ASSERT_EQ(1U, prompts.size());
    EXPECT_EQ(L"Set Animation Location (city, or latitude and longitude) <51.5 -0.12>: ",
              prompts[0]);
}

TEST_F(LocationAtThePrompt, EnterTakesThePlaceThatIsThere) {
    const auto place = choose({L""});
    ASSERT_TRUE(place);
    EXPECT_EQ(51.5, place->latitude_deg);
    EXPECT_EQ(-0.12, place->longitude_deg);
}

TEST_F(LocationAtThePrompt, IsAskedAgainAfterAnAnswerThatIsNone) {
    const auto place = choose({L"Lodnon", L"95 0", L"10 20"});
    ASSERT_TRUE(place);
    EXPECT_EQ(20.0, place->longitude_deg);
    EXPECT_EQ(3U, prompts.size());
    EXPECT_THAT(told, HasSubstr("London"));
    EXPECT_THAT(told, HasSubstr("A place has a latitude from -90 to 90"));
}

TEST_F(LocationAtThePrompt, EndOfInputChoosesNothing) {
    EXPECT_FALSE(choose({}));
    EXPECT_FALSE(choose({L"nowhere at all"}));
}

} // namespace
} // namespace quarn::test
