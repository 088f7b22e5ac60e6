#include <cstdlib>

extern "C" int ForeignHostCall();

namespace {

/// Tells the test that code of this file ran.
struct Tattler {
    Tattler() { setenv("QUARN_TEST_JOURNAL", ForeignHostCall() ? "ran" : "ran too", 1); }
} the_tattler;

} // namespace
