#include "zoetrix/commands/CommandGuard.h"

#include "tests/zoetrix/fixtures/PlugInFixture.h"

#include <new>
#include <stdexcept>

namespace {

class CommandGuard : public PlugInFixture {
protected:
    /// What is printed where the body of a command throws this.
    template <class Exception> std::wstring printedFor(const Exception& exception) {
        front_end.clearPrinted();
        EXPECT_EQ(CQuarnCommand::failure, RunGuarded([&]() -> int { throw exception; }));
        return printed();
    }
};

} // namespace

TEST_F(CommandGuard, LackOfMemoryIsToldAsThat) {
    EXPECT_EQ(L"Not enough memory. Nothing done\n", printedFor(std::bad_alloc()));
    EXPECT_EQ(L"Not enough memory. Nothing done\n", printedFor(std::length_error("vector")));
}

TEST_F(CommandGuard, AnotherExceptionIsToldInItsOwnWords) {
    EXPECT_EQ(L"Unexpected error: no größe. Nothing done\n",
              printedFor(std::out_of_range("no größe")));
    EXPECT_EQ(L"Unexpected error: unknown. Nothing done\n", printedFor(42));
}

TEST_F(CommandGuard, ABodyThatThrowsNothingEndsAsItSays) {
    EXPECT_EQ(CQuarnCommand::cancel, RunGuarded([] { return int{CQuarnCommand::cancel}; }));
    EXPECT_EQ(L"", printed());
}
