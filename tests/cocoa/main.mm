#include <AppKit/AppKit.h>

#include <gtest/gtest.h>

#include <cstdlib>
#include <string>
#include <unistd.h>

namespace {

constexpr const char* TRIES = "QUARN_COCOA_TRIES";
constexpr int MOST_TRIES = 20;

void startApplication() {
    // GNUstep's own title bar, since no window manager runs here; and no icon of the program.
    NSDictionary* const settings =
        [NSDictionary dictionaryWithObjectsAndKeys:@"NO", @"GSX11HandlesWindowDecorations", @"YES",
                                                   @"GSSuppressAppIcon", nil];
    [[NSUserDefaults standardUserDefaults] registerDefaults:settings];
    [NSApplication sharedApplication];
}

/// GNUstep finds no font at all in about one process of ten, whichever fonts there are: it depends
/// on where the process lies in memory.
bool findsFonts() {
    return [NSFont systemFontOfSize:12.0] != nil;
}

/// Begins anew, elsewhere in memory. Returns only when it cannot.
void beginAnew(char** arguments) {
    const char* const tries = getenv(TRIES);
    const int tried = tries ? atoi(tries) : 0;
    if (tried < MOST_TRIES) {
        setenv(TRIES, std::to_string(tried + 1).c_str(), 1);
        execv("/proc/self/exe", arguments);
    }
}

} // namespace

int main(int argument_count, char** arguments) {
    NSAutoreleasePool* const pool = [[NSAutoreleasePool alloc] init];
    startApplication();
    if (!findsFonts())
        beginAnew(arguments);
    testing::InitGoogleTest(&argument_count, arguments);
    const int result = RUN_ALL_TESTS();
    [pool release];
    return result;
}
